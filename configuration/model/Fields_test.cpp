// The read/write convention, exercised through a sample class holding every field type.
#include <gtest/gtest.h>

#include "Configuration/AnonParam.h"
#include "Fields.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

class Sample : public virtual Vesk::Serializable {
public:
    bool readVesk(const Vesk::Element& e) override {
        return Fields::read(*this, e, "Sample", Fields::FailureForm::PartialDefaults);
    }
    Quorvex::auto_ptr<Vesk::Element> writeVesk() const override {
        return Fields::write(*this, "Sample");
    }
    friend bool operator==(const Sample& a, const Sample& b) { return Fields::equal(a, b); }

    ACE_CString text = "default";
    bool flag = true;
    int number = -7;
    unsigned int count = 9;
    unsigned short port = 104;
    BDate date{2010, 3, 4};
    BTime time{5, 6, 7};
    std::vector<ACE_CString> names;
    AnonParam param;
    std::vector<AnonParam> params;

private:
    friend struct Fields::Access;
    template <class Self, class Io>
    static void fields(Self& s, Io& io) {
        io("Text", s.text);
        io("Flag", s.flag);
        io("Number", s.number);
        io("Count", s.count);
        io("Port", s.port);
        io("Date", s.date);
        io("Time", s.time);
        io("Name", s.names);
        io("AnonParam", s.param);
        io("Param", s.params);
    }
};

// A tree holding only the given key/text children under element "Sample".
Vesk::Element tree(std::initializer_list<std::pair<const char*, const char*>> children) {
    Vesk::Element root("Sample", -1);
    Vesk::MultiElementValue& list = root.addMultiElement();
    for (const auto& [key, text] : children) {
        Vesk::Element& child = list.addElement(ACE_CString(key), {}, -1);
        if (text != nullptr) {
            child.addSingle().assign(text);
        }
    }
    return root;
}

Sample filled() {
    Sample s;
    s.text = "a<b>&\"c'";
    s.flag = false;
    s.number = -2147483647 - 1;
    s.count = 4294967295u;
    s.port = 65535;
    s.date = BDate(2024, 2, 29);
    s.time = BTime(23, 59, 59, 999);
    s.names = {"one", "", "three"};
    s.param.setTag("0010,0010");
    AnonParam p;
    p.setValue("anon");
    s.params = {p, AnonParam()};
    return s;
}

TEST(FieldsRoundTrip, EveryTypeReadsBackEqual) {
    const Sample written = filled();
    Sample read;
    EXPECT_TRUE(read.readVesk(*written.writeVesk()));
    EXPECT_TRUE(read == written);
}

TEST(FieldsRoundTrip, WrittenTextsAreTheCanonicalForms) {
    const Quorvex::auto_ptr<Vesk::Element> t = filled().writeVesk();
    const Vesk::MultiElementValue& c = t->getMultiElement();
    EXPECT_EQ(c.getElement("Flag").getSingle().value(), "0");
    EXPECT_EQ(c.getElement("Number").getSingle().value(), "-2147483648");
    EXPECT_EQ(c.getElement("Count").getSingle().value(), "4294967295");
    EXPECT_EQ(c.getElement("Port").getSingle().value(), "65535");
    EXPECT_EQ(c.getElement("Date").getSingle().value(), "2024-02-29");
    EXPECT_EQ(c.getElement("Time").getSingle().value(), BTime(23, 59, 59, 999).ToString());
}

TEST(FieldsRoundTrip, KeysAreWrittenInDeclaredOrderWithListsRepeated) {
    const Quorvex::auto_ptr<Vesk::Element> t = filled().writeVesk();
    std::vector<std::string> keys;
    for (const Vesk::Element& child : t->getMultiElement()) {
        keys.emplace_back(child.key().c_str());
    }
    const std::vector<std::string> expected = {"Text",      "Flag",  "Number", "Count", "Port",
                                               "Date",      "Time",  "Name",   "Name",  "Name",
                                               "AnonParam", "Param", "Param"};
    EXPECT_EQ(keys, expected);
}

TEST(FieldsReading, MissingKeyKeepsDefaultAndReportsFalseWithoutStopping) {
    Sample s;
    EXPECT_FALSE(s.readVesk(tree({{"Text", "x"}, {"Port", "2000"}})));
    EXPECT_EQ(s.text, "x");
    EXPECT_EQ(s.port, 2000);  // read although keys before it were missing
    EXPECT_EQ(s.number, -7);
    EXPECT_TRUE(s.flag);
}

TEST(FieldsReading, ChildWithoutValueEmptiesTheFieldAndCountsAsRead) {
    Sample s;
    s.readVesk(tree({{"Text", nullptr}, {"Flag", nullptr}, {"Number", nullptr}}));
    EXPECT_EQ(s.text, "");
    EXPECT_FALSE(s.flag);
    EXPECT_EQ(s.number, 0);
}

TEST(FieldsReading, UnparsableTextLeavesTheFieldAndCountsAsRead) {
    Sample s;
    Vesk::Element t =
        tree({{"Flag", "true"}, {"Number", "abc"}, {"Count", "x1"}, {"Port", "70000"}});
    s.readVesk(t);
    EXPECT_TRUE(s.flag);  // only "1"/"0" are flags
    EXPECT_EQ(s.number, -7);
    EXPECT_EQ(s.count, 9u);
    EXPECT_EQ(s.port, 104);  // out of range for 16 bits
}

TEST(FieldsReading, StreamSemanticsForNumbers) {
    Sample s;
    s.readVesk(tree({{"Number", " 42xyz"}, {"Flag", "0"}}));
    EXPECT_EQ(s.number, 42);  // leading blanks skipped, trailing text ignored
    EXPECT_FALSE(s.flag);
}

TEST(FieldsReading, FirstOfTwoSameKeyChildrenWins) {
    Sample s;
    s.readVesk(tree({{"Text", "first"}, {"Text", "second"}}));
    EXPECT_EQ(s.text, "first");
}

TEST(FieldsReading, ChildOfAnotherValueKindCountsAsMissing) {
    Vesk::Element t("Sample", -1);
    t.addMultiElement().addElement("Text", {}, -1).addMulti();
    Sample s;
    EXPECT_FALSE(s.readVesk(t));
    EXPECT_EQ(s.text, "default");
}

TEST(FieldsReading, AbsentListsAreEmptyAndNotMissing) {
    Sample s;
    s.names = {"stale"};
    const Quorvex::auto_ptr<Vesk::Element> t = Sample().writeVesk();
    EXPECT_TRUE(s.readVesk(*t));
    EXPECT_TRUE(s.names.empty());
}

TEST(FieldsReading, NestedObjectWithMissingKeyMakesTheWholeReadIncomplete) {
    Sample written;
    Quorvex::auto_ptr<Vesk::Element> t = written.writeVesk();
    Vesk::Element& nested = t->getMultiElement().getElement("AnonParam");
    nested.addMultiElement();  // now empty: every AnonParam key is missing
    Sample s;
    EXPECT_FALSE(s.readVesk(*t));
}

TEST(FieldsReading, WrongRootValueLogsThePartialDefaultsFormAndKeepsDefaults) {
    Quorvex::Testing::LogCapture log;
    Vesk::Element t("Sample", -1);
    t.addSingle().assign("not a list");
    Sample s;
    EXPECT_FALSE(s.readVesk(t));
    EXPECT_TRUE(s == Sample());
    ASSERT_EQ(log.records().size(), 1u);
    EXPECT_EQ(log.records()[0].priority, LM_ERROR);
    EXPECT_EQ(log.records()[0].text.rfind(
                  "Sample::readVesk: Failed - Using partial defaults. Standard Exception: ", 0),
              0u);
}

TEST(FieldsEquality, EveryFieldTakesPart) {
    const Sample base = filled();
    Sample other = base;
    EXPECT_TRUE(other == base);
    other.params[1].setDescription("changed");  // deep inside a list of objects
    EXPECT_FALSE(other == base);
    other = base;
    other.names.pop_back();
    EXPECT_FALSE(other == base);
}

}  // namespace
}  // namespace Configuration
