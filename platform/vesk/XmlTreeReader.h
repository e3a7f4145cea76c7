// XmlTreeReader: turns a document parsed by pugixml into an element tree, checking every node
// against the XML form (docs/XML_FORMAT.md) and the nesting limit. One reader per document; not
// thread-safe.
#pragma once

#include <ace/SString.h>

#include <pugixml.hpp>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"
#include "XmlFormat.h"

namespace Vesk {

class XmlTreeReader {
public:
    // The tree held by doc. TrelException for a DOCTYPE, for anything the writer would not have
    // written, and for nesting deeper than XmlUtils::kMaxDepth.
    static Element read(const pugi::xml_document& doc);
    // Parses text with pugixml (using text as its working buffer) and reads the tree; the same
    // TrelExceptions, plus malformed XML and NUL bytes.
    static Element parse(std::string& text);

private:
    // The key of an e node, after checking its nesting depth and attributes; a view valid until
    // the next call.
    std::string_view readKey(pugi::xml_node node, int depth);
    // Fills element from the children of its e node: attributes and value.
    void readContent(pugi::xml_node node, int depth, Element& element);
    void readAttribute(pugi::xml_node node, Attributes& attributes);
    // Gives target (an Element or a MultiValue) the value that node (of that tag) holds.
    template <class Target>
    void addValue(pugi::xml_node node, XmlFormat::Tag tag, int depth, Target& target);
    void readMulti(pugi::xml_node node, int depth, MultiValue& multi);
    void readList(pugi::xml_node node, int depth, MultiElementValue& list);
    // The text of an s or s64 node, as a view valid until the next call.
    std::string_view nodeText(pugi::xml_node node, bool base64);
    // A string of the document as a view valid until the next call: utf8 converted to 8-bit
    // bytes, or decoded from Base64.
    std::string_view decodeText(const char* utf8, bool base64);

    std::string m_latin1;          // 8-bit bytes of a string that was not plain ASCII
    std::string m_joined;          // a text that pugixml handed out in several pieces
    Quorvex::ByteArray m_decoded;  // bytes decoded from Base64
    std::vector<std::unique_ptr<Element>> m_pending;  // children read, not yet in their list
};

}  // namespace Vesk
