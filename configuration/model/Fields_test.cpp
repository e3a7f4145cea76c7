// The read/write convention: Testing::Convention holds one field of every form the convention
// offers; its written layout is pinned in tests/data/fields/Convention.xml, and each form is read,
// written, round-tripped and compared from that one line.
#include "Fields.h"

#include <gtest/gtest.h>

#include <map>
#include <set>

#include "Configuration/AnonParam.h"
#include "ConventionSample.h"
#include "ElementTestSupport.h"
#include "Vesk/XmlUtils.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Testing::Convention;
using Testing::fileText;
using Testing::Hop;
using Testing::Kind;
using Testing::parsed;

AnonParam param(const char* tag, const char* value) {
    AnonParam p;
    p.setTag(tag);
    p.setValue(value);
    return p;
}

// Every field away from its default.
Convention filled() {
    Convention c;
    c.name = "rule 1";
    c.text = "a<b>&\"c'";
    c.flag = false;
    c.number = -2147483647 - 1;
    c.count = 4294967295u;
    c.port = 65535;
    c.big = -9007199254740993;
    c.size = 18446744073709551615u;
    c.date = BDate(2024, 2, 29);
    c.time = BTime(23, 59, 59, 999);
    c.stamp = BDateTime("2024-02-29T23:59:59.999");
    c.kind = Kind::Report;
    c.named = Kind::Report;
    c.portAsSigned = 4294967295u;
    c.names = {"one", "", "three"};
    c.levels = {3, -1, 7};
    c.param = param("0010,0010", "anon");
    c.params = {param("0008,0020", ""), AnonParam()};
    c.paramCount = 2;
    c.optionalText = "given";
    c.forward = false;
    c.enabledDefault = false;
    c.enabled = false;
    c.txList = "1,2";
    c.hasTxList = true;
    c.kept = {param("k", "1")};
    c.dropped = {param("d", "2")};
    c.byTag = {{"0010,0010", param("0010,0010", "x")}, {"0010,0020", param("0010,0020", "y")}};
    c.titles = {"AE_ONE", "ae_two"};
    c.listed = {"z", "a"};
    c.targets = {{"DIRECT=OS:p1\\private$\\quorvexin", "DIRECT=OS:m1\\private$\\quorvexin"}};
    c.hops = {Hop{"DIRECT=OS:h\\private$\\q", 1, false}};
    c.note = "free text";
    c.mandatory = "given";
    return c;
}

// The written form of every field, pinned.
const Vesk::Element& sample() {
    static const Vesk::Element tree =
        parsed(fileText(std::string(QUORVEX_TEST_DATA) + "/fields/Convention.xml"));
    return tree;
}

// sample() with its children of key removed, and extra appended.
Vesk::Element edited(const char* key, std::initializer_list<Vesk::Element> extra = {}) {
    Vesk::Element copy(sample().key(), -1);
    copy.insertAttributes(sample().attributes());
    Vesk::MultiElementValue& children = copy.addMultiElement();
    for (const Vesk::Element& child : sample().getMultiElement()) {
        if (child.key() != key) {
            children.addElement(child);
        }
    }
    for (const Vesk::Element& e : extra) {
        children.addElement(e);
    }
    return copy;
}

Vesk::Element single(const char* key, const char* text) {
    Vesk::Element e(key, -1);
    e.addSingle().assign(text);
    return e;
}

// A wrapper key holding item children given as (itemKey, tag, value) triples; a null tag leaves
// the item without "Tag".
Vesk::Element wrapper(const char* key, const char* itemKey,
                      std::initializer_list<std::pair<const char*, const char*>> items) {
    Vesk::Element e(key, -1);
    Vesk::MultiElementValue& list = e.addMultiElement();
    for (const auto& [tag, value] : items) {
        Vesk::MultiElementValue& item = list.addElement(itemKey, {}, -1).addMultiElement();
        if (tag != nullptr) {
            item.addElement(single("Tag", tag));
        }
        item.addElement(single("Value", value));
        item.addElement(single("Description", ""));
    }
    return e;
}

TEST(ConventionForms, FilledObjectWritesThePinnedLayoutAndReadsBackEqual) {
    EXPECT_EQ(Vesk::XmlUtils::toString(sample(), Vesk::Ordering::indented()),
              Vesk::XmlUtils::toString(*filled().writeVesk(), Vesk::Ordering::indented()));
    Convention read;
    EXPECT_TRUE(read.readVesk(sample()));
    EXPECT_TRUE(read == filled());
    EXPECT_EQ(2u, read.paramCount);
}

struct AbsentCase {
    const char* key;
    bool complete;  // whether the read still counts as complete
};

// Optional keys, lists and derived data do not make a read incomplete; everything else does.
TEST(ConventionForms, WhichAbsentKeysMakeTheReadIncomplete) {
    const AbsentCase cases[] = {
        {"Text", false},         {"Flag", false},        {"Kind", false},    {"Named", false},
        {"PortAsSigned", false}, {"Name", true},         {"Level", true},    {"AnonParam", false},
        {"Param", true},         {"OptionalText", true}, {"Forward", true},  {"Enabled", true},
        {"TxList", true},        {"Kept", false},        {"Dropped", false}, {"ByTag", false},
        {"Titles", false},       {"Targets", false},     {"Hops", false},    {"Note", false},
        {"ParamCount", true},    {"Mandatory", false}};
    for (const AbsentCase& c : cases) {
        Convention read;
        EXPECT_EQ(c.complete, read.readVesk(edited(c.key))) << c.key;
    }
    Vesk::Element bare(sample().key(), -1);
    bare.setValue(sample().getMultiElement().clone());
    EXPECT_FALSE(Convention().readVesk(bare));  // the "Id" attribute counts as a key
}

// A required key's absence is thrown: the read logs the class's failure, what came before stays.
TEST(ConventionForms, AbsentRequiredKeyIsALoggedFailure) {
    Quorvex::Testing::LogCapture log;
    Convention read;
    EXPECT_FALSE(read.readVesk(edited("Mandatory")));
    EXPECT_EQ("m", read.mandatory);
    EXPECT_EQ("given", read.optionalText);
    ASSERT_EQ(1u, log.records().size());
    EXPECT_NE(std::string::npos, log.records()[0].text.find("Mandatory")) << log.records()[0].text;
}

TEST(ConventionForms, AbsentOptionalKeysKeepTakeOrCopyTheirValues) {
    Convention read = filled();
    EXPECT_TRUE(read.readVesk(edited("OptionalText")));
    EXPECT_EQ("given", read.optionalText);  // unchanged
    read.forward = false;
    read.readVesk(edited("Forward"));
    EXPECT_TRUE(read.forward);  // the given value
    read.readVesk(edited("Enabled"));
    EXPECT_FALSE(read.enabled);  // the value just read for EnabledDefault
    read.readVesk(edited("Enabled", {single("Enabled", "1")}));
    EXPECT_TRUE(read.enabled);
    read.readVesk(edited("TxList"));
    EXPECT_FALSE(read.hasTxList);
    read.readVesk(edited("TxList", {single("TxList", "")}));
    EXPECT_TRUE(read.hasTxList);
}

TEST(ConventionForms, ListPoliciesKeepOrDropIncompleteItems) {
    Convention read;
    EXPECT_FALSE(read.readVesk(
        edited("Kept", {wrapper("Kept", "Item", {{"a", "1"}, {nullptr, "2"}, {"c", "3"}})})));
    ASSERT_EQ(3u, read.kept.size());
    EXPECT_EQ("2", read.kept[1].getValue());
    EXPECT_FALSE(read.readVesk(
        edited("Dropped", {wrapper("Dropped", "Item", {{"a", "1"}, {nullptr, "2"}, {"c", "3"}})})));
    ASSERT_EQ(2u, read.dropped.size());
    EXPECT_EQ("3", read.dropped[1].getValue());
    Vesk::Element emptyWrapper("Kept", -1);  // a wrapper without a value empties the list
    EXPECT_TRUE(read.readVesk(edited("Kept", {emptyWrapper})));
    EXPECT_TRUE(read.kept.empty());
}

TEST(ConventionForms, MapsKeepTheLaterItemAndSetsFoldCase) {
    Convention read;
    EXPECT_TRUE(read.readVesk(edited(
        "ByTag", {wrapper("ByTag", "AnonParam", {{"t", "first"}, {"u", "x"}, {"t", "later"}})})));
    ASSERT_EQ(2u, read.byTag.size());
    EXPECT_EQ("later", read.byTag["t"].getValue());

    Vesk::Element titles("Titles", -1);
    Vesk::MultiValue& values = titles.addMulti();
    for (const char* t : {"ae1", "AE1", "Ae2"}) {
        values.addSingle().assign(t);
    }
    values.addMulti();  // a value of another kind reads as an empty title
    EXPECT_TRUE(read.readVesk(edited("Titles", {titles})));
    EXPECT_EQ(3u, read.titles.size());
    EXPECT_EQ(1u, read.titles.count("AE2"));
}

TEST(ConventionForms, NumbersStoredSignedEnumerationsAndNamedTexts) {
    Convention read;
    read.readVesk(edited("PortAsSigned", {single("PortAsSigned", "-2")}));
    EXPECT_EQ(4294967294u, read.portAsSigned);
    EXPECT_EQ("-2",
              read.writeVesk()->getMultiElement().getElement("PortAsSigned").getSingle().value());
    read.readVesk(edited("Kind", {single("Kind", "2")}));
    EXPECT_EQ(Kind::Report, read.kind);
    read.readVesk(edited("Named", {single("Named", "report")}));  // names are case-sensitive
    EXPECT_EQ(Kind::Image, read.named);
}

TEST(ConventionEquality, EveryComparedFieldTakesPartAndCaseMatters) {
    // filled() differs from the defaults in every field, so hiding any one key changes the read,
    // except for the uncompared note and "Enabled", which then copies the "EnabledDefault" read.
    for (const Vesk::Element& child : sample().getMultiElement()) {
        Convention read;
        read.readVesk(edited(child.key().c_str()));
        EXPECT_EQ(child.key() == "Note" || child.key() == "Enabled", read == filled())
            << child.key().c_str();
    }
    Convention other = filled();
    other.text = "A<B>&\"C'";
    EXPECT_TRUE(other != filled());
}

TEST(ConventionReading, ChildWithoutValueEmptiesTheFieldAndUnparsableTextKeepsIt) {
    Vesk::Element noValue("Text", -1);
    Convention read = filled();
    EXPECT_TRUE(read.readVesk(edited("Text", {noValue})));
    EXPECT_EQ("", read.text);
    const std::pair<const char*, const char*> kept[] = {
        {"Flag", "true"}, {"Count", "x1"}, {"Port", "70000"}, {"Number", "--1"}};
    for (const auto& [key, text] : kept) {
        Convention c = filled();
        EXPECT_TRUE(c.readVesk(edited(key, {single(key, text)})));
        EXPECT_TRUE(c == filled()) << key;
    }
    Convention c;
    c.readVesk(edited("Number", {single("Number", " 42xyz"), single("Number", "43")}));
    EXPECT_EQ(42, c.number);  // leading blanks skipped, trailing text ignored, first child wins
}

TEST(ConventionReading, HookResultJoinsTheRead) {
    Convention read;
    read.hookResult = false;
    EXPECT_FALSE(read.readVesk(sample()));
    EXPECT_EQ(2u, read.paramCount);
}

// Hostile trees end in a logged, failed read, never a crash.
TEST(ConventionReading, WrongValueKindsLogTheFailureAndHugeListsRead) {
    Quorvex::Testing::LogCapture log;
    Vesk::Element notAList("Titles", -1);
    notAList.addMultiElement();
    Vesk::Element notAWrapper("Kept", -1);
    notAWrapper.addSingle().assign("x");
    for (const Vesk::Element& bad : {notAList, notAWrapper}) {
        Convention read;
        EXPECT_FALSE(read.readVesk(edited(bad.key().c_str(), {bad})));
    }
    ASSERT_EQ(2u, log.records().size());
    EXPECT_EQ(
        0u, log.records()[0].text.rfind(
                "Convention::readVesk: Failed - Using partial defaults. Standard Exception: ", 0));

    Vesk::Element many("Listed", -1);
    Vesk::MultiValue& values = many.addMulti();
    for (int i = 0; i < 100000; ++i) {
        values.addSingle().assign("v");
    }
    Convention read;
    EXPECT_TRUE(read.readVesk(edited("Listed", {many})));
    EXPECT_EQ(100000u, read.listed.size());
}

class ReadOnly : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ReadOnly);

public:
    ACE_CString value;
};

template <class Self, class Io>
void ReadOnly::fields(Self& self, Io& io) {
    io("Value", self.value);
}

CONFIGURATION_DEFINE_READ(ReadOnly, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_NO_WRITE(ReadOnly, "ReadOnly::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(ReadOnly)

TEST(ConventionWriting, ReadOnlyClassRefusesWithItsText) {
    try {
        ReadOnly().writeVesk();
        FAIL() << "writeVesk of a read-only class returned";
    } catch (const std::exception& e) {
        EXPECT_STREQ("ReadOnly::writeVesk - Not supported.", e.what());
    }
}

}  // namespace
}  // namespace Configuration
