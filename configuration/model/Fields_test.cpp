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

// "key=text" for each child of s's tree, in order ("key" alone when its value is not a text).
std::string written(const Sample& s) {
    std::string out;
    const Quorvex::auto_ptr<Vesk::Element> root = s.writeVesk();
    for (const Vesk::Element& child : root->getMultiElement()) {
        out += child.key().c_str();
        if (child.value().kind() == Vesk::Value::Kind::Single) {
            out += std::string("=") + child.getSingle().value().c_str();
        }
        out += " ";
    }
    return out;
}

TEST(FieldsRoundTrip, CanonicalTextsInDeclaredOrderReadBackEqual) {
    EXPECT_EQ(written(filled()),
              "Text=a<b>&\"c' Flag=0 Number=-2147483648 Count=4294967295 "
              "Port=65535 Date=2024-02-29 Time=" +
                  std::string(BTime(23, 59, 59, 999).ToString().c_str()) +
                  " Name=one Name= Name=three AnonParam Param Param ");
    Sample read;
    EXPECT_TRUE(read.readVesk(*filled().writeVesk()));
    EXPECT_TRUE(read == filled());
}

TEST(FieldsReading, MissingKeyKeepsTheFieldReportsFalseAndReadingGoesOn) {
    Sample s;
    EXPECT_FALSE(s.readVesk(tree({{"Text", "x"}, {"Port", "2000"}})));
    EXPECT_EQ(s.text, "x");
    EXPECT_EQ(s.port, 2000);  // read although keys before it were missing
    EXPECT_EQ(s.number, -7);
    Vesk::Element otherKind("Sample", -1);  // a child of another value kind counts as missing
    otherKind.addMultiElement().addElement("Text", {}, -1).addMulti();
    EXPECT_FALSE(s.readVesk(otherKind));
    EXPECT_EQ(s.text, "x");

    Quorvex::auto_ptr<Vesk::Element> complete = Sample().writeVesk();
    s.names = {"stale"};
    EXPECT_TRUE(s.readVesk(*complete));  // absent lists are empty, not missing
    EXPECT_TRUE(s.names.empty());
    complete->getMultiElement().getElement("AnonParam").addMultiElement();
    EXPECT_FALSE(Sample().readVesk(*complete));  // a key missing in a nested object counts
}

TEST(FieldsReading, ChildWithoutValueEmptiesTheField) {
    Sample s;
    s.readVesk(tree({{"Text", nullptr}, {"Flag", nullptr}, {"Number", nullptr}}));
    EXPECT_EQ(s.text, "");
    EXPECT_FALSE(s.flag);
    EXPECT_EQ(s.number, 0);
}

TEST(FieldsReading, FirstSameKeyChildWinsAndUnparsableTextKeepsTheField) {
    Sample s;
    s.readVesk(tree({{"Text", "first"},
                     {"Text", "second"},
                     {"Flag", "true"},
                     {"Number", " 42xyz"},
                     {"Count", "x1"},
                     {"Port", "70000"}}));
    EXPECT_EQ(s.text, "first");
    EXPECT_TRUE(s.flag);      // only "1"/"0" are flags
    EXPECT_EQ(s.number, 42);  // leading blanks skipped, trailing text ignored
    EXPECT_EQ(s.count, 9u);
    EXPECT_EQ(s.port, 104);  // out of range for 16 bits
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
    // filled() differs from the defaults in every field, so hiding any one key changes the read.
    for (const char* key : {"Text", "Flag", "Number", "Count", "Port", "Date", "Time", "Name",
                            "AnonParam", "Param"}) {
        Quorvex::auto_ptr<Vesk::Element> t = filled().writeVesk();
        t->getMultiElement().getElement(key).setKey("Hidden");
        Sample read;
        read.readVesk(*t);
        EXPECT_FALSE(read == filled()) << key;
    }
}

}  // namespace
}  // namespace Configuration
