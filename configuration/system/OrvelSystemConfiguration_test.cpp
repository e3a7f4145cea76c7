#include "Configuration/OrvelSystemConfiguration.h"

#include <gtest/gtest.h>

#include <memory>

#include "ElementTestSupport.h"
#include "testing/LogCapture.h"

namespace {

using Configuration::OrvelSystemConfiguration;
using Configuration::Testing::childKeys;
using Configuration::Testing::childText;
using Configuration::Testing::withChild;
using Configuration::Testing::withoutChild;
using Quorvex::Testing::LogCapture;

// Every key set away from its default, sections included.
OrvelSystemConfiguration customised() {
    OrvelSystemConfiguration config;
    config.setFreespaceWatermark(7);
    config.setWorkstationAutoDeleteEnabled(false);
    config.setWorkstationDataProtectionDays(0);
    config.setFilespaceWatermark(4);
    config.setFreespaceWatermarkForStackRecycle(4294967295u);
    config.setStudyDateTimeDataProtectionHours(360);
    Configuration::StackConfiguration__ stack;
    stack.setReconstructDirectoryName("E:\\rebuild\\");
    stack.setReconstructDirectoryNeedsReArchive(true);
    stack.setVolDiscoveryMode(2);
    config.setStack(stack);
    Configuration::RestartConfiguration__ restart;
    restart.setRestartTimeOfDay("04:15");
    restart.setRestartNumberOfDaysBetween(7);
    config.setRestart(restart);
    Configuration::VariationPointConfiguration__ points;
    points.setAutoDeleteStrategy("OldestFirst");
    points.setStorageCommitServiceList(1);
    config.setVariationPoint(points);
    config.setCORBAEndpoints({"iiop://orvel1:2809", "iiop://orvel2:2809"});
    config.setLogRoot("D:\\logs\\");
    config.setMasterConfigurationServiceHostName("orvel-master");
    config.setEnableInversionTesting(true);
    config.setOneTimeInitializationVerified(true);
    config.setAvailableStoragePortCount(3);
    config.setNumberOfConsolidationProcesses(2);
    config.setConsolidationWorkItemDefinition(-5);
    config.setAllowEmptyPatientFirstName(true);
    return config;
}

// An element that holds a single text where a section is expected.
Vesk::Element textElement(const char* key) {
    Vesk::Element text(key, -1);
    text.addSingle().assign("broken");
    return text;
}

// The message className logs when it reads textElement(key).
std::string partialDefaultsMessage(const std::string& className, const char* key) {
    std::string what;
    try {
        textElement(key).getMultiElement();
    } catch (const std::exception& e) {
        what = e.what();
    }
    return className + "::readVesk: Failed - Using partial defaults. Standard Exception: " + what +
           ".\n";
}

TEST(OrvelSystemDocument, IsThePerMachineDocumentOrvelSystem) {
    const OrvelSystemConfiguration config;
    EXPECT_EQ("BrimmetServer\\OrvelSystem", std::string(config.path().c_str()));
    EXPECT_TRUE(config.isLocal());
    EXPECT_EQ("", std::string(config.getMasterConfigurationServiceHostName().c_str()));
}

// Guards that the repository's cache copies keep the whole document, sections included.
TEST(OrvelSystemDocument, CloneKeepsEveryKey) {
    const OrvelSystemConfiguration original = customised();
    const std::unique_ptr<Configuration::ConfigDoc> copy(original.clone());
    EXPECT_EQ(original, dynamic_cast<const OrvelSystemConfiguration&>(*copy));
}

TEST(OrvelSystemSetters, StudyHoursOutsideOneTo360BecomeTwentyFour) {
    OrvelSystemConfiguration config;
    for (const auto& c : {std::make_pair(360u, 360u), {1u, 1u}, {0u, 24u}, {361u, 24u}}) {
        config.setStudyDateTimeDataProtectionHours(c.first);
        EXPECT_EQ(c.second, config.getStudyDateTimeDataProtectionHours()) << c.first;
    }
}

// Days are 1..365, default 8; 0 is allowed only while auto-delete is off.
TEST(OrvelSystemSetters, ZeroWorkstationDaysOnlyWhileAutoDeleteIsOff) {
    OrvelSystemConfiguration config;
    for (const bool autoDelete : {true, false}) {
        config.setWorkstationAutoDeleteEnabled(autoDelete);
        for (const auto& c :
             {std::make_pair(365u, 365u), {0u, autoDelete ? 8u : 0u}, {1u, 1u}, {366u, 8u}}) {
            config.setWorkstationDataProtectionDays(c.first);
            EXPECT_EQ(c.second, config.getWorkstationDataProtectionDays()) << c.first;
        }
    }
}

TEST(OrvelSystemElement, WritesKeysInStoredOrder) {
    const auto element = customised().writeVesk();
    EXPECT_EQ("OrvelSystem", std::string(element->key().c_str()));
    EXPECT_EQ(
        (std::vector<std::string>{
            "FreespaceWatermark", "WorkstationAutoDeleteEnabled", "WorkstationDataProtectionDays",
            "FileespaceWatermark", "FreespaceWatermarkForStackRecycle",
            "StudyDateTimeDataProtectionHours", "Stack", "Restart", "VariationPoint",
            "CORBAEndpoints", "CORBAEndpoints", "LogRoot", "MasterConfigurationServiceHostName",
            "EnableInversionTesting", "OneTimeInitializationVerified", "AvailableStoragePortCount",
            "NumberOfConsolidationProcesses", "ConsolidationWorkItemDefinition",
            "AllowEmptyPatientFirstName"}),
        childKeys(*element));
    EXPECT_EQ("4", childText(*element, "FileespaceWatermark"));
    EXPECT_EQ("-5", childText(*element, "ConsolidationWorkItemDefinition"));
}

TEST(OrvelSystemElement, RoundTripGivesAnEqualDocument) {
    const OrvelSystemConfiguration written = customised();
    OrvelSystemConfiguration read;
    ASSERT_NE(written, read);
    EXPECT_TRUE(read.readVesk(*written.writeVesk()));
    EXPECT_EQ(written, read);
}

// Guards that equality looks into the nested sections.
TEST(OrvelSystemElement, DocumentsDifferingOnlyInASectionAreUnequal) {
    const OrvelSystemConfiguration a = customised();
    OrvelSystemConfiguration b = a;
    Configuration::StackConfiguration__ stack = b.getStack();
    stack.setVolDiscoveryMode(3);
    b.setStack(stack);
    EXPECT_NE(a, b);
}

TEST(OrvelSystemPartialDocument, MissingKeyKeepsItsDefaultAndTheRestIsRead) {
    LogCapture log;
    const auto partial =
        withoutChild(*customised().writeVesk(), "FreespaceWatermarkForStackRecycle");
    OrvelSystemConfiguration read;
    EXPECT_FALSE(read.readVesk(partial));
    EXPECT_EQ(60u, read.getFreespaceWatermarkForStackRecycle());
    EXPECT_EQ(360u, read.getStudyDateTimeDataProtectionHours());
    EXPECT_EQ("orvel-master", std::string(read.getMasterConfigurationServiceHostName().c_str()));
    EXPECT_TRUE(read.isAllowEmptyPatientFirstName());
    EXPECT_EQ(customised().getVariationPoint(), read.getVariationPoint());
    EXPECT_TRUE(log.records().empty());
}

TEST(OrvelSystemPartialDocument, KeyMissingInsideASectionFailsTheDocument) {
    const OrvelSystemConfiguration written = customised();
    const auto element = written.writeVesk();
    const Vesk::Element& stack = element->getMultiElement().getElement("Stack");
    const auto partial = withChild(*element, "Stack", withoutChild(stack, "VolDiscoveryMode"));
    OrvelSystemConfiguration read;
    EXPECT_FALSE(read.readVesk(partial));
    EXPECT_EQ(0u, read.getStack().getVolDiscoveryMode());
    EXPECT_TRUE(read.getStack().isReconstructDirectoryNeedsReArchive());
    EXPECT_EQ(written.getRestart(), read.getRestart());
}

TEST(OrvelSystemPartialDocument, NonSectionDocumentLogsAndKeepsDefaults) {
    LogCapture log;
    OrvelSystemConfiguration read;
    EXPECT_FALSE(read.readVesk(textElement("OrvelSystem")));
    EXPECT_EQ(OrvelSystemConfiguration(), read);
    EXPECT_TRUE(
        log.contains(LM_ERROR, partialDefaultsMessage("OrvelSystemConfiguration", "OrvelSystem")));
}

struct BrokenSection {
    const char* key;
    const char* className;
};

class OrvelSystemBrokenSection : public ::testing::TestWithParam<BrokenSection> {};

// A section holding a single text logs in its own name; the document's other keys are read.
TEST_P(OrvelSystemBrokenSection, LogsInTheSectionsOwnName) {
    LogCapture log;
    const auto partial =
        withChild(*customised().writeVesk(), GetParam().key, textElement(GetParam().key));
    OrvelSystemConfiguration read;
    EXPECT_FALSE(read.readVesk(partial));
    EXPECT_TRUE(
        log.contains(LM_ERROR, partialDefaultsMessage(GetParam().className, GetParam().key)));
    EXPECT_EQ(1u, log.records().size());
    EXPECT_EQ("D:\\logs\\", std::string(read.getLogRoot().c_str()));
}

INSTANTIATE_TEST_SUITE_P(Sections, OrvelSystemBrokenSection,
                         ::testing::Values(BrokenSection{"Stack", "StackConfiguration__"},
                                           BrokenSection{"Restart", "RestartConfiguration__"},
                                           BrokenSection{"VariationPoint",
                                                         "VariationPointConfiguration__"}));

}  // namespace
