// Every configuration class against its sample documents in tests/data/classes: NAME.xml holds a
// value for every key (all different from the defaults), NAME.defaults.xml is what a default
// object writes. A new class adds its two samples and one row to kClasses.
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <set>
#include <string>

#include "Configuration/AnonParam.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "ElementTestSupport.h"
#include "Vesk/XmlUtils.h"
#include "testing/FakeMachine.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

const char kFailed[] = "::readVesk: Failed. Standard Exception: ";
const char kPartialDefaults[] = "::readVesk: Failed - Using partial defaults. Standard Exception: ";

struct ClassRow {
    std::string name;                    // the class: its samples' stem and its log name
    const char* failureForm;             // what its read-failure log line says after the name
    std::set<std::string> optionalKeys;  // keys whose absence does not make the read incomplete
    std::function<std::unique_ptr<Vesk::Serializable>()> make;
    std::function<bool(const Vesk::Serializable&, const Vesk::Serializable&)> equal;
};

template <class T>
ClassRow row(const char* name, const char* failureForm, std::set<std::string> optionalKeys = {}) {
    return ClassRow{name, failureForm, std::move(optionalKeys),
                    [] { return std::make_unique<T>(); },
                    [](const Vesk::Serializable& a, const Vesk::Serializable& b) {
                        return dynamic_cast<const T&>(a) == dynamic_cast<const T&>(b);
                    }};
}

const ClassRow kClasses[] = {
    row<AnonParam>("AnonParam", kFailed),
    row<RestartConfiguration__>("RestartConfiguration__", kPartialDefaults),
    row<VariationPointConfiguration__>("VariationPointConfiguration__", kPartialDefaults),
    row<StackConfiguration__>("StackConfiguration__", kPartialDefaults),
    row<OrvelSystemConfiguration>("OrvelSystemConfiguration", kPartialDefaults, {"CORBAEndpoints"}),
};

// The children of element with that key, in order.
std::vector<Vesk::Element> childrenWith(const Vesk::Element& element, const ACE_CString& key) {
    std::vector<Vesk::Element> found;
    for (const Vesk::Element& child : element.getMultiElement()) {
        if (child.key() == key) {
            found.push_back(child);
        }
    }
    return found;
}

// Samples were written on a machine with drives C: and D: (the stack section's defaults).
class ClassSamples : public testing::TestWithParam<ClassRow> {
protected:
    ClassSamples() { m_machine.drives = {"C:\\", "D:\\"}; }
    const ClassRow& c() const { return GetParam(); }

    Quorvex::Testing::FakeMachine m_machine;
    Quorvex::ScopedMachine m_scoped{m_machine};
    const Vesk::Element m_sample = Testing::sampleDocument(GetParam().name + ".xml");
};

TEST_P(ClassSamples, SampleReadsCompleteAndWritesBackUnchanged) {
    auto object = c().make();
    ASSERT_TRUE(object->readVesk(m_sample));
    EXPECT_EQ(Vesk::XmlUtils::toString(m_sample), Vesk::XmlUtils::toString(*object->writeVesk()));
    auto again = c().make();
    EXPECT_TRUE(again->readVesk(*object->writeVesk()));
    EXPECT_TRUE(c().equal(*again, *object));
    EXPECT_FALSE(c().equal(*object, *c().make()));  // the sample differs from the defaults
}

TEST_P(ClassSamples, DefaultObjectWritesTheDefaultsSample) {
    EXPECT_EQ(Vesk::XmlUtils::toString(Testing::sampleDocument(c().name + ".defaults.xml")),
              Vesk::XmlUtils::toString(*c().make()->writeVesk()));
}

// Each key left out in turn: it keeps its default, every other key is still read, and the read
// reports the document incomplete unless the key is optional.
TEST_P(ClassSamples, EachMissingKeyKeepsItsDefaultAndTheRestIsRead) {
    const Quorvex::auto_ptr<Vesk::Element> defaults = c().make()->writeVesk();
    std::vector<ACE_CString> keys;
    for (const Vesk::Element& child : m_sample.getMultiElement()) {
        if (keys.empty() || keys.back() != child.key()) {
            keys.push_back(child.key());
        }
    }
    for (const ACE_CString& left : keys) {
        Vesk::Element partial(m_sample.key(), -1);
        Vesk::MultiElementValue& children = partial.addMultiElement();
        for (const Vesk::Element& other : m_sample.getMultiElement()) {
            if (other.key() != left) {
                children.addElement(other);
            }
        }
        auto object = c().make();
        EXPECT_EQ(c().optionalKeys.count(left.c_str()) == 1, object->readVesk(partial))
            << left.c_str();
        const Quorvex::auto_ptr<Vesk::Element> written = object->writeVesk();
        std::size_t expectedCount = 0;
        for (const ACE_CString& key : keys) {
            const Vesk::Element& expected = key == left ? *defaults : m_sample;
            expectedCount += childrenWith(expected, key).size();
            EXPECT_EQ(childrenWith(expected, key), childrenWith(*written, key))
                << "without " << left.c_str() << ", key " << key.c_str();
        }
        EXPECT_EQ(expectedCount, written->getMultiElement().size()) << left.c_str();
    }
}

TEST_P(ClassSamples, ElementOfAnotherKindLogsTheClassFailureAndKeepsDefaults) {
    Quorvex::Testing::LogCapture log;
    Vesk::Element notAList(m_sample.key(), -1);
    notAList.addSingle().assign("text");
    auto object = c().make();
    EXPECT_FALSE(object->readVesk(notAList));
    EXPECT_TRUE(c().equal(*object, *c().make()));
    ASSERT_EQ(1u, log.records().size());
    EXPECT_EQ(LM_ERROR, log.records()[0].priority);
    EXPECT_EQ(0u, log.records()[0].text.rfind(c().name + c().failureForm, 0))
        << log.records()[0].text;
}

INSTANTIATE_TEST_SUITE_P(Classes, ClassSamples, testing::ValuesIn(kClasses),
                         [](const testing::TestParamInfo<ClassRow>& info) {
                             return info.param.name;
                         });

}  // namespace
}  // namespace Configuration
