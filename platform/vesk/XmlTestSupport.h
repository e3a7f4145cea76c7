// Helpers for the tests of the XML form: printing a tree and reading it back.
#pragma once

#include <ostream>
#include <string>

#include "Vesk/Element.h"
#include "Vesk/XmlUtils.h"

namespace Vesk {

// Lets GoogleTest show a tree in a failure message as its indented XML.
inline void PrintTo(const Element& element, std::ostream* os) {
    try {
        *os << "\n" << XmlUtils::toString(element, Ordering::indented());
    } catch (const TrelException& e) {
        *os << "<unprintable tree: " << e.what() << ">";
    }
}

namespace Testing {

// The tree read from text.
inline Element parseText(const std::string& text) {
    Element tree;
    XmlUtils::parse(text.data(), text.size(), tree);
    return tree;
}

// tree printed with ordering and read back.
inline Element reparse(const Element& tree, const Ordering& ordering = Ordering()) {
    return parseText(XmlUtils::toString(tree, ordering));
}

// An element with a single value.
inline Element textElement(const ACE_CString& key, const ACE_CString& text) {
    Element element(key);
    element.addSingle().assign(text);
    return element;
}

}  // namespace Testing
}  // namespace Vesk
