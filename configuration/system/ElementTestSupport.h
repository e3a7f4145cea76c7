// Test helpers for looking into written element trees: the keys of an element's children in
// order, the text of one child, and a copy of an element without one of its children.
#pragma once

#include <string>
#include <vector>

#include "Vesk/Element.h"

namespace Configuration {
namespace Testing {

// The keys of element's children, in order.
inline std::vector<std::string> childKeys(const Vesk::Element& element) {
    std::vector<std::string> keys;
    for (const Vesk::Element& child : element.getMultiElement()) {
        keys.emplace_back(child.key().c_str());
    }
    return keys;
}

// The text of element's first child with that key.
inline std::string childText(const Vesk::Element& element, const char* key) {
    return element.getMultiElement().getElement(ACE_CString(key)).getSingle().value().c_str();
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
