// Properties over many seeded random trees and byte strings: printing and reading back gives an
// equal tree in both layouts, the printed text only holds bytes that XML 1.0 allows, and copies
// are equal.
#include <gtest/gtest.h>

#include <memory>
#include <random>
#include <string>

#include "Vesk/XmlUtils.h"
#include "XmlTestSupport.h"

namespace Vesk {
namespace {

using Testing::reparse;
using Testing::textElement;

// Seeded random trees whose strings favour the bytes that need care in XML.
class RandomTrees {
public:
    explicit RandomTrees(unsigned seed) : m_random(seed) {}

    // Up to maxLen bytes out of 1..255.
    ACE_CString bytes(unsigned maxLen) {
        static const char kTricky[] = "<>&\"' \t\r\n\x01\x08\x0B\x1F\x7F\x80\x9F\xA0\xE9\xFF]";
        std::string text(pick(maxLen + 1), ' ');
        for (char& c : text) {
            c = pick(2) == 0 ? kTricky[pick(sizeof kTricky - 1)] : static_cast<char>(1 + pick(255));
        }
        return ACE_CString(text.c_str(), text.size());
    }

    std::unique_ptr<Element> element(int levels) {
        auto element = std::make_unique<Element>(bytes(8));
        for (unsigned i = pick(4); i > 0; --i) {
            element->insertAttributes({{bytes(6), bytes(10)}});
        }
        if (pick(5) != 0) {
            element->setValue(value(levels));
        }
        return element;
    }

    std::unique_ptr<Value> value(int levels) {
        const unsigned kind = levels > 0 ? pick(3) : 0;
        if (kind == 0) {
            return std::make_unique<SingleValue>(bytes(24));
        }
        if (kind == 1) {
            auto multi = std::make_unique<MultiValue>();
            for (unsigned i = pick(5); i > 0; --i) {
                multi->addValue(value(levels - 1));
            }
            return multi;
        }
        auto list = std::make_unique<MultiElementValue>();
        for (unsigned i = pick(5); i > 0; --i) {
            list->addElement(element(levels - 1).release());
        }
        return list;
    }

private:
    unsigned pick(unsigned n) { return static_cast<unsigned>(m_random() % n); }
    std::mt19937 m_random;
};

// Whether text holds only bytes XML 1.0 allows (tab, LF and everything from space up).
bool onlyXmlBytes(const std::string& text) {
    for (char c : text) {
        const unsigned char byte = static_cast<unsigned char>(c);
        if (byte < 0x20 && byte != '\t' && byte != '\n') {
            return false;
        }
    }
    return true;
}

TEST(XmlProperty, RandomTreesRoundTripExactlyInBothLayouts) {
    std::size_t bytes = 0;
    for (unsigned seed = 1; seed <= 300; ++seed) {
        RandomTrees random(seed);
        const std::unique_ptr<Element> tree = random.element(5);
        const std::string compact = XmlUtils::toString(*tree);
        bytes += compact.size();
        ASSERT_TRUE(onlyXmlBytes(compact)) << "seed " << seed;
        ASSERT_EQ(*tree, reparse(*tree)) << "seed " << seed << "\n" << compact;
        ASSERT_EQ(*tree, reparse(*tree, Ordering::indented())) << "seed " << seed;
        ASSERT_EQ(*tree, Element(*tree)) << "seed " << seed;  // copies of every shape
    }
    EXPECT_GT(bytes, 100000u);  // the trees are not trivially small
}

TEST(XmlProperty, EveryByteAndRandomByteStringsSurviveAsKeyAttributeTextAndListItem) {
    RandomTrees random(77u);
    for (int i = 1; i <= 255 + 500; ++i) {
        const char c = static_cast<char>(i);
        const ACE_CString s = i <= 255 ? ACE_CString(&c, 1) : random.bytes(64);
        Element root(s);
        root.insertAttributes({{s, s}});
        MultiValue& values = root.addMulti();
        values.addSingle().assign(s);
        values.addMultiElement().addElement(textElement(s, s));
        ASSERT_TRUE(onlyXmlBytes(XmlUtils::toString(root))) << "string " << i;
        ASSERT_EQ(root, reparse(root)) << "string " << i;
        ASSERT_EQ(root, reparse(root, Ordering::indented())) << "string " << i;
    }
}

}  // namespace
}  // namespace Vesk
