// Automatic export rules: which rules and items a read keeps, criteria of any key, the
// destination look-up, and the refusals to write.
#include <gtest/gtest.h>

#include "Configuration/AutoExportConfiguration.h"
#include "DicomTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Testing::parsed;
using Testing::sampleDocument;

// A document whose rules are the given XML.
Vesk::Element withRules(const std::string& rules) {
    return Testing::withChild(sampleDocument("AutoExportConfiguration.xml"), "AutoExportRules",
                              parsed("<e k=\"AutoExportRules\">" + rules + "</e>"));
}

std::string rule(const std::string& nameAttribute, const std::string& destinations) {
    return "<e k=\"AutoExportRule\">" + nameAttribute +
           "<l><e k=\"Enabled\"><s>1</s></e><e k=\"Criteria\"><l/></e><e k=\"Destinations\"><l>" +
           destinations + "</l></e></l></e>";
}

std::string destination(const std::string& name) {
    return "<e k=\"Destination\"><l><e k=\"DestinationName\"><s>" + name +
           "</s></e><e k=\"IsStorageCommitRequired\"><s>false</s></e></l></e>";
}

TEST(AutoExport, ARuleWithoutANameIsDroppedUnlogged) {
    Quorvex::Testing::LogCapture log;
    AutoExportConfiguration config;
    EXPECT_FALSE(config.readVesk(withRules(
        "<l>" + rule("<a n=\"Name\" v=\"A &lt;b&gt; &amp; &quot;c&quot;\"/>", destination("X")) +
        rule("", destination("Y")) + "</l>")));
    ASSERT_EQ(1u, config.getRules().size());
    EXPECT_EQ("A <b> & \"c\"", config.getRules()[0].getName());
    EXPECT_TRUE(config.getEnabled());  // read after the rules
    EXPECT_TRUE(log.records().empty());

    AutoExportRule unnamed;
    EXPECT_FALSE(unnamed.readVesk(parsed(rule("", destination("Y")))));
    EXPECT_FALSE(unnamed.getEnabled());  // nothing else read
    EXPECT_TRUE(unnamed.getDestinations().empty());
}

TEST(AutoExport, CriteriaTakeAnyKeyAndAnEmptyOneHasNoValue) {
    AutoExportRule read;
    ASSERT_TRUE(read.readVesk(
        parsed("<e k=\"AutoExportRule\"><a n=\"Name\" v=\"r\"/><l><e k=\"Enabled\"><s>0</s></e>"
               "<e k=\"Criteria\"><l><e k=\"Modality\"><s>CT</s></e><e k=\"StationAETitle\"/>"
               "<e k=\"StudyDescription\"><l/></e></l></e><e k=\"Destinations\"><l>" +
               destination("Archive") + "</l></e></l></e>")));
    ASSERT_EQ(3u, read.getCriteria().size());
    EXPECT_EQ("Modality", read.getCriteria()[0].getName());
    EXPECT_EQ("CT", read.getCriteria()[0].getValue());
    EXPECT_EQ("StationAETitle", read.getCriteria()[1].getName());
    EXPECT_EQ("", read.getCriteria()[1].getValue());
    EXPECT_EQ("", read.getCriteria()[2].getValue());  // a value that is not a text
}

TEST(AutoExport, DestinationsOfAnyKeyDropIncompleteOnes) {
    AutoExportRule read;
    EXPECT_FALSE(read.readVesk(parsed(
        rule("<a n=\"Name\" v=\"r\"/>",
             destination("A") + "<e k=\"Other\"><l><e k=\"DestinationName\"><s>B</s></e></l></e>" +
                 "<e k=\"Target\"><l><e k=\"DestinationName\"><s>C</s></e>"
                 "<e k=\"IsStorageCommitRequired\"><s>yes</s></e></l></e>"))));
    ASSERT_EQ(2u, read.getDestinations().size());
    EXPECT_EQ("C", read.getDestinations()[1].GetDestinationName());
    EXPECT_EQ("yes", read.getDestinations()[1].getIsStorageCommitRequired());
}

TEST(AutoExport, AListWithoutAValueKeepsWhatItHeld) {
    AutoExportConfiguration config;
    ASSERT_TRUE(config.readVesk(sampleDocument("AutoExportConfiguration.xml")));
    EXPECT_TRUE(config.readVesk(withRules("")));
    EXPECT_EQ(2u, config.getRules().size());
    EXPECT_TRUE(config.readVesk(withRules("<l/>")));
    EXPECT_TRUE(config.getRules().empty());
}

TEST(AutoExport, WithoutTheRulesTheReadFailsLoggedAndTheDefaultsStay) {
    Quorvex::Testing::LogCapture log;
    AutoExportConfiguration config;
    EXPECT_FALSE(config.readVesk(
        Testing::withoutChild(sampleDocument("AutoExportConfiguration.xml"), "AutoExportRules")));
    EXPECT_FALSE(config.getEnabled());
    EXPECT_EQ(5, config.getMaxRetries());
    EXPECT_EQ(10, config.getRetryDelay());
    EXPECT_TRUE(
        log.onlyStartsWith("AutoExportConfiguration::readVesk: Failed. Standard Exception: "));
}

TEST(AutoExport, DestinationLookUpIgnoresCaseAndTheRulesSwitch) {
    AutoExportConfiguration config;
    ASSERT_TRUE(config.readVesk(sampleDocument("AutoExportConfiguration.xml")));
    ASSERT_FALSE(config.getRules()[1].getEnabled());
    const struct {
        const char* name;
        bool used;
    } kAsked[] = {
        {"Long-term archive", true},
        {"LONG-TERM ARCHIVE", true},
        {"teleradiology PARTNER", true},  // named by a disabled rule only
        {"Long-term", false},
        {"Long-term archive ", false},
        {"", false},
    };
    for (const auto& asked : kAsked) {
        EXPECT_EQ(asked.used, config.isDestinationUsed(asked.name)) << asked.name;
    }
    EXPECT_FALSE(AutoExportRule().hasDestination(""));
    config.clear();
    EXPECT_FALSE(config.isDestinationUsed("Long-term archive"));
    EXPECT_FALSE(AutoExportConfiguration::IsAutoExportFeatureTurnedOff());
}

TEST(AutoExport, EveryClassRefusesToWrite) {
    const std::pair<const Vesk::Serializable*, const char*> kRefusals[] = {
        {new Criterion(), "Criterion::writeVesk - Class cannot be serialized."},
        {new Destination(), "Criterion::writeVesk - Class cannot be serialized."},
        {new AutoExportRule(), "AutoExportRule::writeVesk - Class cannot be serialized."},
        {new AutoExportConfiguration(),
         "AutoExportConfiguration::writeVesk - Class cannot be serialized."},
    };
    for (const auto& [object, text] : kRefusals) {
        try {
            object->writeVesk();
            ADD_FAILURE() << text;
        } catch (const std::exception& e) {
            EXPECT_STREQ(text, e.what());
        }
        delete object;
    }
}

}  // namespace
}  // namespace Configuration
