// Answer texts written element by element, with text escaped.
#include "Answer.h"

namespace ConfigurationService {

Answer::Answer(const std::string& rootTag) : m_root(rootTag) {
    m_text.reserve(256);
    m_text += '<';
    m_text += m_root;
    m_text += '>';
}

Answer& Answer::element(const std::string& tag, const std::string& text) {
    open(tag);
    m_text += escape(text);
    return close(tag);
}

Answer& Answer::trusted(const std::string& tag, const char* text, std::size_t length) {
    m_text.reserve(m_text.size() + length + 2 * tag.size() + 16);
    open(tag);
    m_text.append(text, length);
    return close(tag);
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
    out.reserve(text.size());
    for (char c : text) {
        switch (c) {
            case '&':
                out += "&amp;";
                break;
            case '<':
                out += "&lt;";
                break;
            case '>':
                out += "&gt;";
                break;
            default:
                out += c;
        }
    }
    return out;
}

}  // namespace ConfigurationService
