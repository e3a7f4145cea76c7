#include "XmlTreeReader.h"

#include <cstring>
#include <stdexcept>
#include <string>
#include <utility>

#include "Latin1.h"
#include "Quorvex/Base64Coder.h"
#include "Vesk/XmlUtils.h"

namespace Vesk {

namespace {

// Whitespace-only texts are kept (a value may be all blanks) and the first text of a node is held
// in the node itself, which saves a node per value. Fragment mode makes pugixml keep text outside
// the root element, so that the reader can refuse it instead of pugixml dropping it; a DOCTYPE
// becomes a node so that the reader can refuse it. pugixml never expands entities of its own.
constexpr unsigned int kParseOptions = pugi::parse_default | pugi::parse_ws_pcdata |
                                       pugi::parse_embed_pcdata | pugi::parse_doctype |
                                       pugi::parse_fragment;

using XmlFormat::Tag;

[[noreturn]] void refuse(const std::string& what) {
    throw TrelException("Vesk::XmlUtils: " + what);
}

// A node name for a message, cut short: it comes from the input.
std::string shown(const char* name) {
    const std::size_t kMax = 32;
    const std::size_t len = std::strlen(name);
    return "<" + std::string(name, len < kMax ? len : kMax) + (len > kMax ? "...>" : ">");
}

void checkDepth(int depth) {
    if (depth > XmlUtils::kMaxDepth) {
        refuse("the XML nests deeper than " + std::to_string(XmlUtils::kMaxDepth) + " levels");
    }
}

bool isBlank(const char* s) {
    for (; *s != '\0'; ++s) {
        if (*s != ' ' && *s != '\t' && *s != '\n' && *s != '\r') {
            return false;
        }
    }
    return true;
}

// Structural nodes (e, m, l and the document) may hold whitespace between their children only.
void requireBlank(const char* text, const char* where) {
    if (!isBlank(text)) {
        refuse(std::string("text is not allowed ") + where);
    }
}

// A child of a structural node that is not an element: whitespace, or refused.
void requireBlankNode(pugi::xml_node node, const char* where) {
    if (node.type() == pugi::node_doctype) {
        refuse("a DOCTYPE is not accepted");
    }
    if (node.type() != pugi::node_pcdata && node.type() != pugi::node_cdata) {
        refuse(std::string("unexpected markup ") + where);
    }
    requireBlank(node.value(), where);
}

void requireNoAttributes(pugi::xml_node node) {
    if (node.first_attribute()) {
        refuse(shown(node.name()) + " takes no attributes");
    }
}

std::size_t countElements(pugi::xml_node node) {
    std::size_t count = 0;
    for (pugi::xml_node child = node.first_child(); child; child = child.next_sibling()) {
        count += child.type() == pugi::node_element ? 1 : 0;
    }
    return count;
}

// Whether the attribute is called plain, or plain followed by "64" (then base64 is set).
bool isText(pugi::xml_attribute attribute, const char* plain, bool& base64) {
    const char* name = attribute.name();
    if (name[0] != plain[0]) {
        return false;
    }
    base64 = std::strcmp(name + 1, "64") == 0;
    return name[1] == '\0' || base64;
}

}  // namespace

Element XmlTreeReader::parse(std::string& text) {
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
    return read(doc);
}

Element XmlTreeReader::read(const pugi::xml_document& doc) {
    pugi::xml_node root;
    for (pugi::xml_node child = doc.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            requireBlankNode(child, "outside the root element");
        } else if (root) {
            refuse("more than one root element");
        } else {
            root = child;
        }
    }
    if (!root) {
        refuse("no root element");
    }
    if (XmlFormat::classify(root.name()) != Tag::Element) {
        refuse("the root element must be <e>, not " + shown(root.name()));
    }
    XmlTreeReader reader;
    const std::string_view key = reader.readKey(root, 1);
    Element tree(key.data(), key.size(), -1);
    reader.readContent(root, 1, tree);
    return tree;
}

std::string_view XmlTreeReader::readKey(pugi::xml_node node, int depth) {
    checkDepth(depth);
    const pugi::xml_attribute key = node.first_attribute();
    bool base64 = false;
    if (!key || key.next_attribute() || !isText(key, "k", base64)) {
        refuse("<e> takes exactly one attribute, k or k64");
    }
    return decodeText(key.value(), base64);
}

void XmlTreeReader::readContent(pugi::xml_node node, int depth, Element& element) {
    requireBlank(node.value(), "inside <e>");
    Attributes attributes;
    for (pugi::xml_node child = node.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            requireBlankNode(child, "inside <e>");
            continue;
        }
        const Tag tag = XmlFormat::classify(child.name());
        if (tag == Tag::Element || tag == Tag::Unknown) {
            refuse("unexpected " + shown(child.name()) + " inside <e>");
        }
        if (element.hasValue()) {
            refuse(tag == Tag::Attribute ? "<a> after the value of <e>"
                                         : "more than one value inside <e>");
        }
        if (tag == Tag::Attribute) {
            readAttribute(child, attributes);
        } else {
            addValue(child, tag, depth + 1, element);
        }
    }
    if (!attributes.empty()) {
        element.insertAttributes(attributes);
    }
}

void XmlTreeReader::readAttribute(pugi::xml_node node, Attributes& attributes) {
    const pugi::xml_attribute name = node.first_attribute();
    const pugi::xml_attribute value = name.next_attribute();
    bool nameBase64 = false;
    bool valueBase64 = false;
    if (!name || !value || value.next_attribute() || !isText(name, "n", nameBase64) ||
        !isText(value, "v", valueBase64)) {
        refuse("<a> takes exactly two attributes, n (or n64) and v (or v64), in that order");
    }
    if (node.first_child() || node.value()[0] != '\0') {
        refuse("<a> must be empty");
    }
    // Each view is copied before the next decodeText reuses its buffer.
    attributes.emplace_back();
    const std::string_view first = decodeText(name.value(), nameBase64);
    attributes.back().first.set(first.data(), first.size(), true);
    const std::string_view second = decodeText(value.value(), valueBase64);
    attributes.back().second.set(second.data(), second.size(), true);
}

template <class Target>
void XmlTreeReader::addValue(pugi::xml_node node, Tag tag, int depth, Target& target) {
    switch (tag) {
        case Tag::Single:
        case Tag::Single64: {
            const std::string_view text = nodeText(node, tag == Tag::Single64);
            target.addSingle().assign(text.data(), text.size());
            return;
        }
        case Tag::Multi:
            readMulti(node, depth, target.addMulti());
            return;
        case Tag::List:
            readList(node, depth, target.addMultiElement());
            return;
        default:
            refuse("expected a value, found " + shown(node.name()));
    }
}

void XmlTreeReader::readMulti(pugi::xml_node node, int depth, MultiValue& multi) {
    checkDepth(depth);
    requireNoAttributes(node);
    requireBlank(node.value(), "inside <m>");
    multi.reserve(countElements(node));
    for (pugi::xml_node child = node.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            requireBlankNode(child, "inside <m>");
            continue;
        }
        const Tag tag = XmlFormat::classify(child.name());
        if (tag == Tag::Element || tag == Tag::Attribute || tag == Tag::Unknown) {
            refuse("unexpected " + shown(child.name()) + " inside <m>");
        }
        addValue(child, tag, depth + 1, multi);
    }
}

void XmlTreeReader::readList(pugi::xml_node node, int depth, MultiElementValue& list) {
    checkDepth(depth);
    requireNoAttributes(node);
    requireBlank(node.value(), "inside <l>");
    // The children wait on m_pending (shared by all levels) until their count is known, so that
    // the list is allocated once at its exact size without walking the nodes twice.
    const std::size_t first = m_pending.size();
    for (pugi::xml_node child = node.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            requireBlankNode(child, "inside <l>");
            continue;
        }
        if (XmlFormat::classify(child.name()) != Tag::Element) {
            refuse("unexpected " + shown(child.name()) + " inside <l>");
        }
        const std::string_view key = readKey(child, depth + 1);
        std::unique_ptr<Element> element(new Element(key.data(), key.size(), -1));
        Element& filled = *element;
        m_pending.push_back(std::move(element));
        readContent(child, depth + 1, filled);
    }
    list.reserve(m_pending.size() - first);
    for (std::size_t i = first; i < m_pending.size(); ++i) {
        list.addElement(m_pending[i].release());
    }
    m_pending.resize(first);
}

std::string_view XmlTreeReader::nodeText(pugi::xml_node node, bool base64) {
    requireNoAttributes(node);
    pugi::xml_node child = node.first_child();
    if (!child) {
        return decodeText(node.value(), base64);
    }
    // Comments and CDATA sections split a text into several nodes.
    m_joined.assign(node.value());
    for (; child; child = child.next_sibling()) {
        if (child.type() != pugi::node_pcdata && child.type() != pugi::node_cdata) {
            refuse(shown(node.name()) + " holds text only");
        }
        m_joined.append(child.value());
    }
    return decodeText(m_joined.c_str(), base64);
}

std::string_view XmlTreeReader::decodeText(const char* utf8, bool base64) {
    if (!base64) {
        return Latin1::view(utf8, m_latin1);
    }
    std::size_t len = 0;
    try {
        m_decoded = Base64Coder::Decode(utf8, std::strlen(utf8), len);
    } catch (const std::invalid_argument&) {
        refuse("a string marked as Base64 is not valid Base64");
    }
    return len == 0 ? std::string_view("", 0)  // never a null pointer, even when empty
                    : std::string_view(reinterpret_cast<const char*>(m_decoded.get()), len);
}

}  // namespace Vesk
