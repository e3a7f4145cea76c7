// Answer: the text of one answer of the configuration service. Answers are not XML documents to
// be parsed but texts from which clients cut elements by their exact marks "<Tag>" and "</Tag>",
// so every element is written as an opening tag without attributes, its escaped text and a
// closing tag (never self-closing). Legacy answers carry "ReturnStatus" ("1" success, "0"
// failure with "ErrorMessage"); error answers also carry the error record ("ErrorKey",
// "ErrorCode", "ErrorMessage", ...) so that either kind of client reads them. A plain value.
#pragma once

#include <cstddef>
#include <string>

namespace ConfigurationService {

class Answer {
public:
    // An answer whose root element is rootTag.
    explicit Answer(const std::string& rootTag);

    // Appends <tag>escaped text</tag>.
    Answer& element(const std::string& tag, const std::string& text);
    Answer& element(const std::string& tag, const char* text, std::size_t length);
    // Appends <tag>Base64 of the bytes</tag>, encoded in place; with reserve() beforehand the
    // answer is built in one buffer of its final size.
    Answer& base64(const std::string& tag, const void* data, std::size_t length);
    // Makes room for more characters of elements plus the root's closing tag, so that finish()
    // returns a text whose capacity is its size when exactly that much is appended.
    void reserve(std::size_t more);
    // Opens and closes a nesting element.
    Answer& open(const std::string& tag);
    Answer& close(const std::string& tag);
    // Closes the root and returns the text.
    std::string finish();
    // Opens tag and returns the text so far; tail receives the closing tags of tag and of the
    // root. For an answer whose last element's text is sent from a copy kept elsewhere.
    std::string finishAround(const std::string& tag, std::string& tail);

    // A legacy success carrying what was appended, as <root><ReturnStatus>1</ReturnStatus>...
    static Answer success(const std::string& operation);
    // A failure readable by legacy clients and by clients that read the error record.
    static std::string failure(const std::string& operation, const std::string& message,
                               const std::string& errorKey = std::string());
    // Escapes &, < and > for element text.
    static std::string escape(const std::string& text);
    // The length of <tag>escaped text</tag>.
    static std::size_t elementSize(const std::string& tag, const char* text, std::size_t length);
    // The length of <tag>text</tag> for length characters that need no escaping.
    static std::size_t plainElementSize(const std::string& tag, std::size_t length) {
        return 2 * tag.size() + 5 + length;
    }
    // The length of <tag>Base64 of length bytes</tag>.
    static std::size_t base64ElementSize(const std::string& tag, std::size_t length);

private:
    std::string m_root;
    std::string m_text;
};

}  // namespace ConfigurationService
