// AnonParam: the worked example of the convention.
#include "Configuration/AnonParam.h"

#include <gtest/gtest.h>

#include "testing/LogCapture.h"

namespace Configuration {
namespace {

TEST(AnonParam, EmptyListReadsFalseAndLeavesStringsEmpty) {
    Vesk::Element e("AnonParam", -1);
    e.addMultiElement();
    AnonParam p;
    EXPECT_FALSE(p.readVesk(e));
    EXPECT_EQ(p.getTag(), "");
    EXPECT_EQ(p.getValue(), "");
    EXPECT_EQ(p.getDescription(), "");
}

TEST(AnonParam, TagWithoutValueIsEmptyAndStillComplete) {
    Vesk::Element e("AnonParam", -1);
    Vesk::MultiElementValue& c = e.addMultiElement();
    c.addElement("Tag", {}, -1);
    c.addElement("Value", {}, -1).addSingle().assign("v");
    c.addElement("Description", {}, -1).addSingle().assign("d");
    AnonParam p;
    p.setTag("old");
    EXPECT_TRUE(p.readVesk(e));
    EXPECT_EQ(p.getTag(), "");
    EXPECT_EQ(p.getValue(), "v");
}

TEST(AnonParam, DefaultWritesThreeEmptyChildrenInOrder) {
    const Quorvex::auto_ptr<Vesk::Element> e = AnonParam().writeVesk();
    EXPECT_EQ(e->key(), "AnonParam");
    const char* keys[] = {"Tag", "Value", "Description"};
    std::size_t i = 0;
    for (const Vesk::Element& child : e->getMultiElement()) {
        ASSERT_LT(i, 3u);
        EXPECT_EQ(child.key(), keys[i++]);
        EXPECT_EQ(child.getSingle().value(), "");
    }
    EXPECT_EQ(i, 3u);
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

TEST(AnonParam, CopyAssignAndCompare) {
    AnonParam a;
    a.setTag("0010,0020");
    a.setValue("X");
    a.setDescription("Patient ID");
    AnonParam b(a);
    EXPECT_TRUE(a == b);
    b.setDescription("patient id");  // case matters
    EXPECT_TRUE(a != b);
    b = a;
    EXPECT_FALSE(a != b);
    AnonParam c;
    EXPECT_TRUE(c.readVesk(*a.writeVesk()));
    EXPECT_TRUE(c == a);
}

}  // namespace
}  // namespace Configuration
