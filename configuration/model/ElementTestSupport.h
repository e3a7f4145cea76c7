// Test helpers for element trees: a file's text, an XML text's tree, a class's sample document
// from tests/data/classes, and copies of an element without, or with another, child of one key.
#pragma once

#include <fstream>
#include <sstream>
#include <string>

#include "Vesk/Element.h"
#include "Vesk/XmlUtils.h"

namespace Configuration {
namespace Testing {

// The bytes of the file at path ("" when it cannot be read).
inline std::string fileText(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// The tree of an XML text.
inline Vesk::Element parsed(const std::string& xml) {
    Vesk::Element tree;
    Vesk::XmlUtils::parse(xml.data(), xml.size(), tree);
    return tree;
}

// The tree of tests/data/classes/file.
inline Vesk::Element sampleDocument(const std::string& file) {
    return parsed(fileText(std::string(QUORVEX_TEST_DATA) + "/classes/" + file));
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
