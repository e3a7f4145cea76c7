#include "Vesk/XmlEmitter.h"

#include <string>

#include "Vesk/TrelException.h"
#include "XmlEscape.h"

namespace Vesk {

namespace {

void appendEscaped(std::string& out, const ACE_CString& text, XmlEscape::Mode mode) {
    if (!XmlEscape::append(out, text.c_str(), text.length(), mode)) {
        throw TrelException(
            "Vesk::XmlEmitter: a text holds a control character that XML 1.0 cannot carry");
    }
}

}  // namespace

void XmlEmitter::startElement(const ACE_CString& name, const XmlAttributes& attributes) {
    std::string tag;
    tag.reserve(name.length() + 2);
    tag.push_back('<');
    tag.append(name.c_str(), name.length());
    for (const auto& attribute : attributes.items()) {
        tag.push_back(' ');
        tag.append(attribute.first.c_str(), attribute.first.length());
        tag.append("=\"");
        appendEscaped(tag, attribute.second, XmlEscape::Mode::AttributeValue);
        tag.push_back('"');
    }
    tag.push_back('>');
    m_out.write(tag);
    m_open.push_back(name);
}

void XmlEmitter::characters(const ACE_CString& text) {
    std::string escaped;
    escaped.reserve(text.length());
    appendEscaped(escaped, text, XmlEscape::Mode::TextAndQuotes);
    m_out.write(escaped);
}

void XmlEmitter::endElement() {
    if (m_open.empty()) {
        throw TrelException("Vesk::XmlEmitter::endElement: no element is open");
    }
    const ACE_CString& name = m_open.back();
    std::string tag;
    tag.reserve(name.length() + 3);
    tag.append("</");
    tag.append(name.c_str(), name.length());
    tag.push_back('>');
    m_out.write(tag);
    m_open.pop_back();
}

void XmlEmitter::textElement(const ACE_CString& name, const ACE_CString& text) {
    startElement(name);
    characters(text);
    endElement();
}

}  // namespace Vesk
