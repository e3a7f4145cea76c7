#include "JsonText.h"

#include <cstdio>

namespace Configctl {

std::string jsonString(const std::string& text) {
    std::string out = "\"";
    for (unsigned char c : text) {
        if (c == '"' || c == '\\') {
            out += '\\';
            out += static_cast<char>(c);
        } else if (c == '\n') {
            out += "\\n";
        } else if (c == '\t') {
            out += "\\t";
        } else if (c < 0x20 || c >= 0x7f) {
            char escaped[8];
            std::snprintf(escaped, sizeof escaped, "\\u%04x", static_cast<unsigned>(c));
            out += escaped;
        } else {
            out += static_cast<char>(c);
        }
    }
    return out + "\"";
}

// A comma before every element or member but the first of its container.
void JsonWriter::separate() {
    if (m_afterKey) {
        m_afterKey = false;
        return;
    }
    if (!m_empty.empty()) {
        if (!m_empty.back()) {
            m_out << ',';
        }
        m_empty.back() = false;
    }
}

JsonWriter& JsonWriter::raw(const std::string& token) {
    separate();
    m_out << token;
    if (m_empty.empty()) {
        m_out << '\n';
    }
    return *this;
}

JsonWriter& JsonWriter::close(char bracket) {
    m_out << bracket;
    m_empty.pop_back();
    if (m_empty.empty()) {
        m_out << '\n';
    }
    return *this;
}

JsonWriter& JsonWriter::open(char bracket) {
    separate();
    m_out << bracket;
    m_empty.push_back(true);
    return *this;
}

JsonWriter& JsonWriter::beginObject() {
    return open('{');
}

JsonWriter& JsonWriter::endObject() {
    return close('}');
}

JsonWriter& JsonWriter::beginArray() {
    return open('[');
}

JsonWriter& JsonWriter::endArray() {
    return close(']');
}

JsonWriter& JsonWriter::key(const char* name) {
    separate();
    m_out << jsonString(name) << ':';
    m_afterKey = true;
    return *this;
}

JsonWriter& JsonWriter::value(const std::string& text) {
    return raw(jsonString(text));
}

JsonWriter& JsonWriter::value(bool flag) {
    return raw(flag ? "true" : "false");
}

}  // namespace Configctl
