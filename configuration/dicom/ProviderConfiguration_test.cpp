// The two service providers' documents: the storage provider's sources and AE-title filter, its
// two setters of one name, and where a read ending on a failure stops in each document's reading
// order (which differs from its written order).
#include <gtest/gtest.h>

#include "Configuration/QrscpConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "DicomTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Testing::parsed;
using Testing::sampleDocument;
using Testing::withChild;

// A "DicomSources" element holding sources; a source named "no model" lacks "Model".
Vesk::Element sources(std::initializer_list<const char*> names) {
    Vesk::Element list("DicomSources", -1);
    Vesk::MultiElementValue& children = list.addMultiElement();
    for (const char* name : names) {
        Vesk::MultiElementValue& source = Testing::child(children, "ServerDicomSource");
        for (const char* key : {"SourceName", "AeTitle", "Modality", "Manufacturer", "SerialNumber",
                                "Model", "StudyDateRangeStart", "StudyDateRangeEnd"}) {
            if (std::string(key) != "Model" || std::string(name) != "no model") {
                Testing::text(source, key, key == std::string("SourceName") ? name : "x");
            }
        }
    }
    return list;
}

struct SourcesCase {
    const char* what;
    Vesk::Element list;
    std::size_t count;  // sources after reading
    bool complete;
};

TEST(SSCPConfiguration, SourcesDropIncompleteOnesAndMayBeEmptyButNotAbsent) {
    Vesk::Element empty("DicomSources", -1);
    Vesk::Element text("DicomSources", -1);
    text.addSingle().assign("CT_ROOM2");
    const SourcesCase cases[] = {
        {"three, one without Model", sources({"CT", "no model", "US"}), 2, false},
        {"empty element", empty, 0, true},
        {"text instead of a list", text, 0, false},  // unreadable: not logged
    };
    const Vesk::Element sample = sampleDocument("SSCPConfiguration.xml");
    Quorvex::Testing::LogCapture log;
    for (const SourcesCase& c : cases) {
        SSCPConfiguration config;
        const bool complete = config.readVesk(withChild(sample, "DicomSources", c.list));
        EXPECT_EQ(c.complete, complete) << c.what;
        EXPECT_EQ(c.count, config.getDicomSources().size()) << c.what;
        EXPECT_EQ(20u, config.getDicomErrorFolderMaxSizeinGB()) << c.what;  // read before
    }
    SSCPConfiguration config;
    EXPECT_FALSE(config.readVesk(Testing::withoutChild(sample, "DicomSources")));
    EXPECT_TRUE(config.getUseSSL());
    EXPECT_TRUE(log.records().empty());
}

TEST(SSCPConfiguration, SourcesKeepTheirOrderAndTexts) {
    SSCPConfiguration config;
    ASSERT_TRUE(config.readVesk(sampleDocument("SSCPConfiguration.xml")));
    ASSERT_EQ(2u, config.getDicomSources().size());
    const ServerDicomSource& ct = config.getDicomSources()[0];
    EXPECT_EQ("CT_ROOM2", ct.getAETitle());
    EXPECT_EQ("Aurion 128", ct.getModel());
    EXPECT_EQ("20190101", ct.getStudyDateRangeStart());
    EXPECT_EQ("", config.getDicomSources()[1].getStudyDateRangeEnd());
}

TEST(SSCPConfiguration, TheFilterIgnoresCase) {
    SSCPConfiguration config;
    ASSERT_TRUE(config.readVesk(
        withChild(sampleDocument("SSCPConfiguration.xml"), "SuidGenerationAETitleFilter",
                  parsed("<e k=\"SuidGenerationAETitleFilter\"><m><s>us_ward</s><s>US_WARD</s>"
                         "<s>Ct_1</s></m></e>"))));
    const SSCPConfiguration::AETitleSet& filter = config.getSuidGenerationAETitleFilter();
    EXPECT_EQ(2u, filter.size());
    EXPECT_EQ(1u, filter.count("Us_Ward"));
    EXPECT_EQ(1u, filter.count("CT_1"));
    EXPECT_EQ(0u, filter.count("CT_"));
}

TEST(SSCPConfiguration, SetPortOfIntSetsTheCallbackSize) {
    SSCPConfiguration config;
    config.setPort(4096);  // int
    EXPECT_EQ(4096, config.getMergeLibraryMinimumCallbackDataSize());
    EXPECT_EQ(104u, config.getPort());
    config.setPort(11112u);
    EXPECT_EQ(11112u, config.getPort());
    EXPECT_EQ(4096, config.getMergeLibraryMinimumCallbackDataSize());
}

// A filter that is not a list ends the read there: keys read before it in reading order have
// their new values, keys after it ("UseSSL", "DicomErrorFolderMaxSizeinGB", the sources) keep
// their defaults, whatever the written order says.
TEST(SSCPConfiguration, AFailureEndsTheReadInReadingOrderAndIsLoggedInItsOwnForm) {
    Vesk::Element notAList("SuidGenerationAETitleFilter", -1);
    notAList.addMultiElement();
    Quorvex::Testing::LogCapture log;
    SSCPConfiguration config;
    EXPECT_FALSE(config.readVesk(withChild(sampleDocument("SSCPConfiguration.xml"),
                                           "SuidGenerationAETitleFilter", notAList)));
    EXPECT_FALSE(config.getAppendStudyDateToGeneratedSuid());  // read
    EXPECT_FALSE(config.getUseSSL());                          // not read
    EXPECT_FALSE(config.getReplaceNonLatin1DuringImport());    // not read
    EXPECT_EQ(5u, config.getDicomErrorFolderMaxSizeinGB());
    EXPECT_TRUE(config.getDicomSources().empty());
    ASSERT_EQ(1u, log.records().size());
    EXPECT_EQ(LM_ERROR, log.records()[0].priority);
    EXPECT_EQ(0u, log.records()[0].text.rfind("SSCPConfiguration::readVesk: Failed - using partial "
                                              "defaults. Standard Exception: ",
                                              0));
    EXPECT_NE('.', log.records()[0].text[log.records()[0].text.size() - 2]);
}

TEST(QrscpConfiguration, AFailureEndsTheReadInReadingOrder) {
    Vesk::Element notAList("AllowedAeTitles", -1);
    notAList.addSingle().assign("VIEWER_WS01");
    Quorvex::Testing::LogCapture log;
    QrscpConfiguration config;
    EXPECT_FALSE(config.readVesk(
        withChild(sampleDocument("QrscpConfiguration.xml"), "AllowedAeTitles", notAList)));
    EXPECT_EQ(5000, config.getMaxDatabaseResults());  // read before the titles
    EXPECT_EQ(11113, config.getPort());
    EXPECT_FALSE(config.getUseSSL());  // after them
    EXPECT_EQ("", config.getSSLPrivateKey());
    EXPECT_TRUE(log.onlyStartsWith("QrscpConfiguration::readVesk: Failed."));
}

TEST(QrscpConfiguration, AllowedTitlesKeepOrderAndDuplicates) {
    QrscpConfiguration config;
    ASSERT_TRUE(config.readVesk(
        withChild(sampleDocument("QrscpConfiguration.xml"), "AllowedAeTitles",
                  parsed("<e k=\"AllowedAeTitles\"><m><s>B</s><s>a</s><s>B</s></m></e>"))));
    EXPECT_EQ((std::vector<ACE_CString>{"B", "a", "B"}), config.getAllowedAeTitles());
}

}  // namespace
}  // namespace Configuration
