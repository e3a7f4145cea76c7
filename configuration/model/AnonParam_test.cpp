// AnonParam: the worked example of the convention (its keys, its failure form, its equality).
#include "Configuration/AnonParam.h"

#include <gtest/gtest.h>

#include "testing/LogCapture.h"

namespace Configuration {
namespace {

TEST(AnonParam, DefaultWritesThreeEmptyChildrenInOrder) {
    Vesk::Element expected("AnonParam");
    Vesk::MultiElementValue& children = expected.addMultiElement();
    for (const char* key : {"Tag", "Value", "Description"}) {
        children.addElement(key, {}, -1).addSingle();
    }
    EXPECT_EQ(expected, *AnonParam().writeVesk());
}

TEST(AnonParam, NonListElementLogsFailedFormAndKeepsDefaults) {
    Quorvex::Testing::LogCapture log;
    Vesk::Element e("AnonParam", -1);
    e.addMulti();
    AnonParam p;
    EXPECT_FALSE(p.readVesk(e));
    EXPECT_TRUE(p == AnonParam());
    ASSERT_EQ(log.records().size(), 1u);
    EXPECT_EQ(log.records()[0].text.rfind("AnonParam::readVesk: Failed. Standard Exception: ", 0),
              0u);
}

TEST(AnonParam, CopiesAndRoundTripsCompareEqualAndCaseMatters) {
    AnonParam a;
    a.setTag("0010,0020");
    a.setValue("X");
    a.setDescription("Patient ID");
    AnonParam b(a);
    EXPECT_TRUE(a == b);
    b.setDescription("patient id");
    EXPECT_TRUE(a != b);
    AnonParam c;
    EXPECT_TRUE(c.readVesk(*a.writeVesk()));
    EXPECT_TRUE(c == a);
}

}  // namespace
}  // namespace Configuration
