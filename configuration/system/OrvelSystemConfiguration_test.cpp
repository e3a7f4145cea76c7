#include "Configuration/OrvelSystemConfiguration.h"

#include <gtest/gtest.h>

#include <memory>

#include "ElementTestSupport.h"

namespace {

using Configuration::OrvelSystemConfiguration;
using Configuration::Testing::sampleDocument;
using Configuration::Testing::withChild;
using Configuration::Testing::withoutChild;

// Every key away from its default, sections included: the class's sample document.
OrvelSystemConfiguration customised() {
    OrvelSystemConfiguration config;
    EXPECT_TRUE(config.readVesk(sampleDocument("OrvelSystemConfiguration.xml")));
    return config;
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

// Guards that equality looks into the nested sections.
TEST(OrvelSystemElement, DocumentsDifferingOnlyInASectionAreUnequal) {
    const OrvelSystemConfiguration a = customised();
    OrvelSystemConfiguration b = a;
    Configuration::StackConfiguration__ stack = b.getStack();
    stack.setVolDiscoveryMode(3);
    b.setStack(stack);
    EXPECT_NE(a, b);
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

}  // namespace
