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
    return std::move(*reader.readElement(root, 1));
}

std::unique_ptr<Element> XmlTreeReader::readElement(pugi::xml_node node, int depth) {
    checkDepth(depth);
    const pugi::xml_attribute key = node.first_attribute();
    bool base64 = false;
    if (!key || key.next_attribute() || !isText(key, "k", base64)) {
        refuse("<e> takes exactly one attribute, k or k64");
    }
    auto element = std::make_unique<Element>(decodeText(key.value(), base64), -1);
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
        if (element->hasValue()) {
            refuse(tag == Tag::Attribute ? "<a> after the value of <e>"
                                         : "more than one value inside <e>");
        }
        if (tag == Tag::Attribute) {
            readAttribute(child, attributes);
        } else {
            element->setValue(readValue(child, tag, depth + 1));
        }
    }
    if (!attributes.empty()) {
        element->insertAttributes(attributes);
    }
    return element;
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
    // Assignment copies each view before the next decodeText reuses its buffer.
    attributes.emplace_back();
    attributes.back().first = decodeText(name.value(), nameBase64);
    attributes.back().second = decodeText(value.value(), valueBase64);
}

std::unique_ptr<Value> XmlTreeReader::readValue(pugi::xml_node node, Tag tag, int depth) {
    switch (tag) {
        case Tag::Single:
        case Tag::Single64:
            return std::make_unique<SingleValue>(nodeText(node, tag == Tag::Single64));
        case Tag::Multi:
            return readMulti(node, depth);
        case Tag::List:
            return readList(node, depth);
        default:
            refuse("expected a value, found " + shown(node.name()));
    }
}

std::unique_ptr<Value> XmlTreeReader::readMulti(pugi::xml_node node, int depth) {
    checkDepth(depth);
    requireNoAttributes(node);
    requireBlank(node.value(), "inside <m>");
    auto multi = std::make_unique<MultiValue>();
    multi->reserve(countElements(node));
    for (pugi::xml_node child = node.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            requireBlankNode(child, "inside <m>");
            continue;
        }
        const Tag tag = XmlFormat::classify(child.name());
        if (tag == Tag::Element || tag == Tag::Attribute || tag == Tag::Unknown) {
            refuse("unexpected " + shown(child.name()) + " inside <m>");
        }
        multi->addValue(readValue(child, tag, depth + 1));
    }
    return multi;
}

std::unique_ptr<Value> XmlTreeReader::readList(pugi::xml_node node, int depth) {
    checkDepth(depth);
    requireNoAttributes(node);
    requireBlank(node.value(), "inside <l>");
    auto list = std::make_unique<MultiElementValue>();
    list->reserve(countElements(node));
    for (pugi::xml_node child = node.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            requireBlankNode(child, "inside <l>");
            continue;
        }
        if (XmlFormat::classify(child.name()) != Tag::Element) {
            refuse("unexpected " + shown(child.name()) + " inside <l>");
        }
        list->addElement(readElement(child, depth + 1).release());
    }
    return list;
}

ACE_CString XmlTreeReader::nodeText(pugi::xml_node node, bool base64) {
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

ACE_CString XmlTreeReader::decodeText(const char* utf8, bool base64) {
    if (!base64) {
        return Latin1::view(utf8, m_latin1);
    }
    std::size_t len = 0;
    Quorvex::ByteArray bytes;
    try {
        bytes = Base64Coder::Decode(utf8, std::strlen(utf8), len);
    } catch (const std::invalid_argument&) {
        refuse("a string marked as Base64 is not valid Base64");
    }
    m_decoded.clear();
    if (len != 0) {
        m_decoded.assign(reinterpret_cast<const char*>(bytes.get()), len);
    }
    return ACE_CString(m_decoded.data(), m_decoded.size(), nullptr, false);
}

}  // namespace Vesk
