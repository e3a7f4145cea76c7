// Answer texts written element by element, with text escaped.
#include "Answer.h"

#include <algorithm>

#include "Quorvex/Base64Coder.h"

namespace ConfigurationService {
namespace {

// Appends text with &, < and > escaped.
void appendEscaped(std::string& out, const char* text, std::size_t length) {
    const char* const end = text + length;
    while (text != end) {
        const char* plain = text;
        while (plain != end && *plain != '&' && *plain != '<' && *plain != '>') {
            ++plain;
        }
        out.append(text, plain);
        if (plain == end) {
            break;
        }
        out += *plain == '&' ? "&amp;" : *plain == '<' ? "&lt;" : "&gt;";
        text = plain + 1;
    }
}

}  // namespace

Answer::Answer(const std::string& rootTag) : m_root(rootTag) {
    m_text.reserve(256);
    m_text += '<';
    m_text += m_root;
    m_text += '>';
}

Answer& Answer::element(const std::string& tag, const std::string& text) {
    return element(tag, text.data(), text.size());
}

Answer& Answer::element(const std::string& tag, const char* text, std::size_t length) {
    open(tag);
    appendEscaped(m_text, text, length);
    return close(tag);
}

Answer& Answer::base64(const std::string& tag, const void* data, std::size_t length) {
    open(tag);
    // Encoded through a small buffer that stays in cache: the answer is written once and never
    // zero-filled first.
    constexpr std::size_t kChunk = 3 * 1024;
    char encoded[kChunk / 3 * 4];
    const auto* bytes = static_cast<const unsigned char*>(data);
    for (std::size_t at = 0; at < length; at += kChunk) {
        const std::size_t n = std::min(kChunk, length - at);
        m_text.append(encoded, Base64Coder::EncodeInto(bytes + at, n, encoded));
    }
    return close(tag);
}

void Answer::reserve(std::size_t more) {
    m_text.reserve(m_text.size() + more + m_root.size() + 3);
}

Answer& Answer::open(const std::string& tag) {
    m_text += '<';
    m_text += tag;
    m_text += '>';
    return *this;
}

Answer& Answer::close(const std::string& tag) {
    m_text += "</";
    m_text += tag;
    m_text += '>';
    return *this;
}

std::string Answer::finish() {
    close(m_root);
    return std::move(m_text);
}

std::string Answer::finishAround(const std::string& tag, std::string& tail) {
    open(tag);
    tail.reserve(tag.size() + m_root.size() + 5);
    tail += "</";
    tail += tag;
    tail += "></";
    tail += m_root;
    tail += '>';
    return std::move(m_text);
}

Answer Answer::success(const std::string& operation) {
    Answer answer(operation + "Response");
    answer.element("ReturnStatus", "1");
    return answer;
}

std::string Answer::failure(const std::string& operation, const std::string& message,
                            const std::string& errorKey) {
    Answer answer((operation.empty() ? std::string("Error") : operation) + "Response");
    answer.element("ReturnStatus", "0");
    answer.element("ErrorMessage", message);
    answer.element("ErrorKey", errorKey);
    answer.element("ErrorCode", "");
    answer.element("LocalizedErrorMessage", message);
    answer.element("ErrorOriginalStackTrace", "");
    return answer.finish();
}

std::string Answer::escape(const std::string& text) {
    std::string out;
    out.reserve(elementSize("", text.data(), text.size()) - 5);
    appendEscaped(out, text.data(), text.size());
    return out;
}

std::size_t Answer::elementSize(const std::string& tag, const char* text, std::size_t length) {
    std::size_t size = plainElementSize(tag, length);
    for (const char* end = text + length; text != end; ++text) {
        size += *text == '&' ? 4 : (*text == '<' || *text == '>') ? 3 : 0;
    }
    return size;
}

std::size_t Answer::base64ElementSize(const std::string& tag, std::size_t length) {
    return plainElementSize(tag, Base64Coder::EncodedLength(length));
}

}  // namespace ConfigurationService
