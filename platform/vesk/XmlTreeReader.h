// XmlTreeReader: turns a document parsed by pugixml into an element tree, checking every node
// against the XML form (docs/XML_FORMAT.md) and the nesting limit. One reader per document; not
// thread-safe.
#pragma once

#include <ace/SString.h>

#include <pugixml.hpp>

#include <memory>
#include <string>

#include "Vesk/Element.h"
#include "XmlFormat.h"

namespace Vesk {

class XmlTreeReader {
public:
    // The tree held by doc. TrelException for a DOCTYPE, for anything the writer would not have
    // written, and for nesting deeper than XmlUtils::kMaxDepth.
    static Element read(const pugi::xml_document& doc);

private:
    std::unique_ptr<Element> readElement(pugi::xml_node node, int depth);
    void readAttribute(pugi::xml_node node, Attributes& attributes);
    std::unique_ptr<Value> readValue(pugi::xml_node node, XmlFormat::Tag tag, int depth);
    std::unique_ptr<Value> readMulti(pugi::xml_node node, int depth);
    std::unique_ptr<Value> readList(pugi::xml_node node, int depth);
    // The text of an s or s64 node, as a view valid until the next call.
    ACE_CString nodeText(pugi::xml_node node, bool base64);
    // A string of the document as a view valid until the next call: utf8 converted to 8-bit
    // bytes, or decoded from Base64. Copy it (by assignment or a const-reference parameter)
    // before the next call; initialising a variable from the result does not copy.
    ACE_CString decodeText(const char* utf8, bool base64);

    std::string m_latin1;   // 8-bit bytes of a string that was not plain ASCII
    std::string m_joined;   // a text that pugixml handed out in several pieces
    std::string m_decoded;  // bytes decoded from Base64
};

}  // namespace Vesk
