#include "Vesk/XmlUtils.h"

#include <pugixml.hpp>

#include <cstring>
#include <string>
#include <utility>

#include "Quorvex/StreamException.h"
#include "XmlDirectReader.h"
#include "XmlTreeReader.h"
#include "XmlTreeWriter.h"

namespace Vesk {
namespace XmlUtils {

namespace {

// Whitespace-only texts are kept (a value may be all blanks) and the first text of a node is held
// in the node itself, which saves a node per value. Fragment mode makes pugixml keep text outside
// the root element, so that the reader can refuse it instead of pugixml dropping it; a DOCTYPE
// becomes a node so that the reader can refuse it. pugixml never expands entities of its own.
constexpr unsigned int kParseOptions = pugi::parse_default | pugi::parse_ws_pcdata |
                                       pugi::parse_embed_pcdata | pugi::parse_doctype |
                                       pugi::parse_fragment;

void checkSize(std::size_t len) {
    if (len > kMaxTextBytes) {
        throw TrelException("Vesk::XmlUtils: the XML text has " + std::to_string(len) +
                            " bytes, more than the limit of " + std::to_string(kMaxTextBytes));
    }
}

void checkRootName(const Element& tree, const ACE_CString& name) {
    if (!name.empty() && !(tree.key() == name)) {
        throw TrelException("Vesk::XmlUtils: the root element is '" +
                            std::string(tree.key().c_str(), tree.key().length()) + "', expected '" +
                            std::string(name.c_str(), name.length()) + "'");
    }
}

// Parses text (which it uses as pugixml's working buffer) into out. Text in the writer's own
// shape is read directly, without a DOM; pugixml reads (or refuses) everything else.
void parseInPlace(std::string& text, Element& out, const ACE_CString& name) {
    checkSize(text.size());
    {
        Element direct;
        if (XmlDirectReader::read(text.data(), text.size(), direct)) {
            checkRootName(direct, name);
            out = std::move(direct);
            return;
        }
    }
    if (std::memchr(text.data(), '\0', text.size()) != nullptr) {
        throw TrelException("Vesk::XmlUtils: the XML text holds a NUL byte");
    }
    pugi::xml_document doc;
    // The terminating NUL goes in too: pugixml overwrites the last byte of its buffer with its
    // own terminator, which would otherwise cut the last byte of a stray trailing text.
    const pugi::xml_parse_result result =
        doc.load_buffer_inplace(&text[0], text.size() + 1, kParseOptions);
    if (!result) {
        throw TrelException("Vesk::XmlUtils: malformed XML at byte " +
                            std::to_string(result.offset) + ": " + result.description());
    }
    Element tree = XmlTreeReader::read(doc);
    checkRootName(tree, name);
    out = std::move(tree);
}

}  // namespace

void streamIn(InputStream& in, Element& out, const ACE_CString& name) {
    std::string text;
    try {
        text = in.readAll(kMaxTextBytes);
    } catch (const Quorvex::StreamException& e) {
        throw TrelException(std::string("Vesk::XmlUtils::streamIn: cannot read the XML text: ") +
                            e.what());
    }
    parseInPlace(text, out, name);
}

void parse(const char* text, std::size_t len, Element& out, const ACE_CString& name) {
    checkSize(len);
    std::string copy(text, len);
    parseInPlace(copy, out, name);
}

void streamOut(const Element& element, OutputStream& out, const Ordering& ordering,
               const ACE_CString& name) {
    std::string text;
    XmlTreeWriter(text, ordering.layout()).writeDocument(element, name.empty() ? nullptr : &name);
    out.write(text);
}

std::string toString(const Element& element, const Ordering& ordering) {
    std::string text;
    XmlTreeWriter(text, ordering.layout()).writeDocument(element, nullptr);
    return text;
}

}  // namespace XmlUtils
}  // namespace Vesk
