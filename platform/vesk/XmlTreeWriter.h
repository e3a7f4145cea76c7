// XmlTreeWriter: prints an element tree in its XML form (docs/XML_FORMAT.md) into a string.
// One writer per document; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <string>

#include "Vesk/Element.h"
#include "Vesk/Ordering.h"

namespace Vesk {

class XmlTreeWriter {
public:
    XmlTreeWriter(std::string& out, Ordering::Layout layout)
        : m_out(out), m_indented(layout == Ordering::Layout::Indented) {}

    // Appends the declaration and the tree; rootKey, when not null, replaces the root's key.
    // TrelException when the tree nests deeper than XmlUtils::kMaxDepth (it could not be read).
    void writeDocument(const Element& root, const ACE_CString* rootKey);

private:
    void writeElement(const Element& element, const ACE_CString& key, int depth);
    void writeAttribute(const ACE_CString& name, const ACE_CString& value, int depth);
    void writeValue(const Value& value, int depth);
    void writeSingle(const SingleValue& value);
    void writeMulti(const MultiValue& value, int depth);
    void writeList(const MultiElementValue& value, int depth);
    // ` name="text"`, or ` name64="base64"` when text cannot be carried as it stands.
    void writeText(const char* name, const ACE_CString& text);
    // Starts the line of a node at depth (indentation), and ends it (line break).
    void openLine(int depth);
    void closeLine();

    std::string& m_out;
    bool m_indented;
};

}  // namespace Vesk
