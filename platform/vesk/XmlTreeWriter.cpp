#include "XmlTreeWriter.h"

#include <string>

#include "Quorvex/Base64Coder.h"
#include "Vesk/XmlUtils.h"
#include "XmlEscape.h"
#include "XmlFormat.h"

namespace Vesk {

namespace {

// Depth counts the nesting of e, m and l nodes, the root being 1; the reader counts the same.
void checkDepth(int depth) {
    if (depth > XmlUtils::kMaxDepth) {
        throw TrelException("Vesk::XmlUtils::streamOut: the tree nests deeper than " +
                            std::to_string(XmlUtils::kMaxDepth) +
                            " levels, which the XML form does not accept");
    }
}

ACE_CString base64(const ACE_CString& text) {
    return Base64Coder::Encode(reinterpret_cast<const unsigned char*>(text.c_str()), text.length());
}

}  // namespace

void XmlTreeWriter::writeDocument(const Element& root, const ACE_CString* rootKey) {
    m_out.append(XmlFormat::kDeclaration);
    closeLine();
    writeElement(root, rootKey != nullptr ? *rootKey : root.key(), 1);
}

void XmlTreeWriter::writeElement(const Element& element, const ACE_CString& key, int depth) {
    checkDepth(depth);
    openLine(depth);
    m_out.append("<e");
    writeText("k", key);
    m_out.push_back('>');
    const bool oneLine = element.attributes().empty() &&
                         (!element.hasValue() || element.value().kind() == Value::Kind::Single);
    if (oneLine) {
        if (element.hasValue()) {
            writeSingle(element.getSingle());
        }
    } else {
        closeLine();
        for (const auto& attribute : element.attributes()) {
            writeAttribute(attribute.first, attribute.second, depth + 1);
        }
        if (element.hasValue()) {
            writeValue(element.value(), depth + 1);
        }
        openLine(depth);
    }
    m_out.append("</e>");
    closeLine();
}

void XmlTreeWriter::writeAttribute(const ACE_CString& name, const ACE_CString& value, int depth) {
    openLine(depth);
    m_out.append("<a");
    writeText("n", name);
    writeText("v", value);
    m_out.append("/>");
    closeLine();
}

void XmlTreeWriter::writeValue(const Value& value, int depth) {
    switch (value.kind()) {
        case Value::Kind::Single:
            openLine(depth);
            writeSingle(static_cast<const SingleValue&>(value));
            closeLine();
            break;
        case Value::Kind::Multi:
            writeMulti(static_cast<const MultiValue&>(value), depth);
            break;
        case Value::Kind::MultiElement:
            writeList(static_cast<const MultiElementValue&>(value), depth);
            break;
    }
}

void XmlTreeWriter::writeSingle(const SingleValue& value) {
    const ACE_CString& text = value.value();
    m_out.append("<s>");
    if (XmlEscape::append(m_out, text.c_str(), text.length(), XmlEscape::Mode::Text)) {
        m_out.append("</s>");
        return;
    }
    m_out.resize(m_out.size() - 3);
    m_out.append("<s64>");
    const ACE_CString encoded = base64(text);
    m_out.append(encoded.c_str(), encoded.length());
    m_out.append("</s64>");
}

void XmlTreeWriter::writeMulti(const MultiValue& value, int depth) {
    checkDepth(depth);
    openLine(depth);
    m_out.append("<m>");
    if (value.size() != 0) {
        closeLine();
        for (const Value& item : value) {
            writeValue(item, depth + 1);
        }
        openLine(depth);
    }
    m_out.append("</m>");
    closeLine();
}

void XmlTreeWriter::writeList(const MultiElementValue& value, int depth) {
    checkDepth(depth);
    openLine(depth);
    m_out.append("<l>");
    if (value.size() != 0) {
        closeLine();
        for (const Element& child : value) {
            writeElement(child, child.key(), depth + 1);
        }
        openLine(depth);
    }
    m_out.append("</l>");
    closeLine();
}

void XmlTreeWriter::writeText(const char* name, const ACE_CString& text) {
    const std::size_t start = m_out.size();
    m_out.push_back(' ');
    m_out.append(name);
    m_out.append("=\"");
    if (!XmlEscape::append(m_out, text.c_str(), text.length(), XmlEscape::Mode::AttributeValue)) {
        m_out.resize(start);
        m_out.push_back(' ');
        m_out.append(name);
        m_out.append("64=\"");
        const ACE_CString encoded = base64(text);
        m_out.append(encoded.c_str(), encoded.length());
    }
    m_out.push_back('"');
}

void XmlTreeWriter::openLine(int depth) {
    if (m_indented) {
        m_out.append(static_cast<std::size_t>(depth - 1) * 2, ' ');
    }
}

void XmlTreeWriter::closeLine() {
    if (m_indented) {
        m_out.push_back('\n');
    }
}

}  // namespace Vesk
