// The DICOM client's viewable SOP classes: what tests/data/dicom/DicomClientCases.xml reads to,
// and how a document without the list is refused.
#include <gtest/gtest.h>

#include "Configuration/DicomClientConfiguration.h"
#include "DicomTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

TEST(DicomClientConfiguration, ViewableClassesKeyedByUidLaterWinsFailedDropped) {
    DicomClientConfiguration config;
    EXPECT_FALSE(config.readVesk(Testing::dicomDocument("DicomClientCases.xml")));
    const auto& viewable = config.getViewableSopClasses();
    ASSERT_EQ(viewable.size(), 2u);
    EXPECT_EQ(viewable.at("1.2.840.10008.5.1.4.1.1.2").getName(), "CT Image Storage, later");
    const struct {
        const char* uid;
        bool viewable;
    } kAsked[] = {
        {"1.2.840.10008.5.1.4.1.1.2", true},  {"private.Viewer.Class", true},
        {"PRIVATE.VIEWER.CLASS", false},     // whole and case-sensitive
        {"1.2.840.10008.5.1.4.1.1", false},  // a prefix is not the class
        {"1.2.840.10008.5.1.4.1.1.4", false}, {"", false},
    };
    for (const auto& asked : kAsked) {
        EXPECT_EQ(config.IsSopClassViewable(asked.uid), asked.viewable) << asked.uid;
    }
}

// Reading empties the map first: a second document replaces the first.
TEST(DicomClientConfiguration, ReadingReplacesWhatWasRead) {
    DicomClientConfiguration config;
    config.readVesk(Testing::dicomDocument("DicomClientCases.xml"));
    Vesk::Element tree("DicomClient", -1);
    Vesk::MultiElementValue& classes = Testing::child(tree.addMultiElement(), "ViewableSOPClasses");
    Vesk::MultiElementValue& mr = Testing::child(classes, "SOPClass");
    Testing::text(mr, "name", "MR Image Storage");
    Testing::text(mr, "uid", "1.2.840.10008.5.1.4.1.1.4");
    EXPECT_TRUE(config.readVesk(tree));
    EXPECT_EQ(config.getViewableSopClasses().size(), 1u);
    EXPECT_TRUE(config.IsSopClassViewable("1.2.840.10008.5.1.4.1.1.4"));
}

TEST(DicomClientConfiguration, WithoutTheListTheReadFailsLoggedAndKeepsTheMap) {
    DicomClientConfiguration config;
    config.readVesk(Testing::dicomDocument("DicomClientCases.xml"));
    const DicomClientConfiguration before = config;
    Vesk::Element empty("DicomClient", -1);
    empty.addMultiElement();
    Quorvex::Testing::LogCapture log;
    EXPECT_FALSE(config.readVesk(empty));
    EXPECT_EQ(config, before);
    EXPECT_TRUE(
        log.onlyStartsWith("DicomClientConfiguration::readVesk: Failed. Standard Exception: "));
}

}  // namespace
}  // namespace Configuration
