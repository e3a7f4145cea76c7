// Test helpers for element trees: a class's sample document from tests/data/classes, and copies
// of an element without, or with another, child of one key.
#pragma once

#include <fstream>
#include <sstream>
#include <string>

#include "Vesk/Element.h"
#include "Vesk/XmlUtils.h"

namespace Configuration {
namespace Testing {

// The tree of tests/data/classes/file.
inline Vesk::Element sampleDocument(const std::string& file) {
    std::ifstream in(std::string(QUORVEX_TEST_DATA) + "/classes/" + file, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    Vesk::Element tree;
    Vesk::XmlUtils::parse(text.str().data(), text.str().size(), tree);
    return tree;
}

// A copy of element without its children of that key.
inline Vesk::Element withoutChild(const Vesk::Element& element, const char* key) {
    Vesk::Element copy(element.key(), -1);
    Vesk::MultiElementValue& children = copy.addMultiElement();
    for (const Vesk::Element& child : element.getMultiElement()) {
        if (child.key() != key) {
            children.addElement(child);
        }
    }
    return copy;
}

// A copy of element whose child of that key is replaced by replacement.
inline Vesk::Element withChild(const Vesk::Element& element, const char* key,
                               const Vesk::Element& replacement) {
    Vesk::Element copy(element.key(), -1);
    Vesk::MultiElementValue& children = copy.addMultiElement();
    for (const Vesk::Element& child : element.getMultiElement()) {
        children.addElement(child.key() == key ? replacement : child);
    }
    return copy;
}

}  // namespace Testing
}  // namespace Configuration
