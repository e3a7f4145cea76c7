// Parsing user-workflow messages with pugixml.
#include "workflow/WorkflowRequest.h"

#include <pugixml.hpp>

#include "workflow/WorkflowError.h"

namespace ConfigurationService {
namespace Workflow {
namespace {

// A message is one operation with a few parameters or one record: far fewer tags than this.
constexpr std::size_t kMaxTags = 1024;

bool tooManyTags(const std::string& body) {
    std::size_t tags = 0;
    for (char c : body) {
        if (c == '<' && ++tags > kMaxTags) {
            return true;
        }
    }
    return false;
}

pugi::xml_node firstElement(const pugi::xml_node& parent) {
    for (pugi::xml_node child = parent.first_child(); child; child = child.next_sibling()) {
        if (child.type() == pugi::node_element) {
            return child;
        }
    }
    return pugi::xml_node();
}

std::string textOf(const pugi::xml_node& element) {
    std::string text;
    for (pugi::xml_node child = element.first_child(); child; child = child.next_sibling()) {
        if (child.type() == pugi::node_pcdata || child.type() == pugi::node_cdata) {
            text += child.value();
        }
    }
    return asUtf8(text);
}

// The text elements of a record.
Fields fieldsOf(const pugi::xml_node& record) {
    Fields fields;
    for (pugi::xml_node child = record.first_child(); child; child = child.next_sibling()) {
        if (child.type() == pugi::node_element) {
            fields.emplace(asUtf8(child.name()), textOf(child));
        }
    }
    return fields;
}

std::size_t utf8Length(unsigned char lead) {
    return lead < 0x80           ? 1
           : (lead >> 5) == 0x6  ? 2
           : (lead >> 4) == 0xe  ? 3
           : (lead >> 3) == 0x1e ? 4
                                 : 0;
}

bool isUtf8(const std::string& text) {
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t length = utf8Length(static_cast<unsigned char>(text[at]));
        if (length == 0 || at + length > text.size()) {
            return false;
        }
        for (std::size_t i = 1; i < length; ++i) {
            if ((static_cast<unsigned char>(text[at + i]) & 0xc0) != 0x80) {
                return false;
            }
        }
        at += length;
    }
    return true;
}

}  // namespace

std::string asUtf8(const std::string& text) {
    if (isUtf8(text)) {
        return text;
    }
    std::string utf8;
    utf8.reserve(text.size() * 2);
    for (char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte < 0x80) {
            utf8 += c;
        } else {
            utf8 += static_cast<char>(0xc0 | (byte >> 6));
            utf8 += static_cast<char>(0x80 | (byte & 0x3f));
        }
    }
    return utf8;
}

WorkflowRequest WorkflowRequest::parse(const std::string& body) {
    if (tooManyTags(body)) {
        throw WorkflowError::bad("the message holds more than " + std::to_string(kMaxTags) +
                                 " tags; a message is one operation with a few parameters");
    }
    pugi::xml_document document;
    const pugi::xml_parse_result parsed =
        document.load_buffer(body.data(), body.size(), pugi::parse_default, pugi::encoding_utf8);
    if (!parsed) {
        throw WorkflowError::bad(std::string("the message is not well-formed XML: ") +
                                 parsed.description() + " at offset " +
                                 std::to_string(parsed.offset));
    }
    const pugi::xml_node message = document.document_element();
    if (std::string(message.name()) != "Message") {
        throw WorkflowError::bad("a user-workflow request is a <Message> element");
    }
    const pugi::xml_node operation = firstElement(message);
    if (!operation) {
        throw WorkflowError::bad("the message names no operation");
    }
    WorkflowRequest request;
    request.operation = asUtf8(operation.name());
    for (pugi::xml_node child = operation.first_child(); child; child = child.next_sibling()) {
        if (child.type() != pugi::node_element) {
            continue;
        }
        const pugi::xml_node record = firstElement(child);
        if (record) {
            request.record = fieldsOf(record);
        } else {
            request.parameters.emplace(asUtf8(child.name()), textOf(child));
        }
    }
    return request;
}

std::string WorkflowRequest::parameter(const char* name) const {
    const auto it = parameters.find(name);
    return it == parameters.end() ? std::string() : it->second;
}

}  // namespace Workflow
}  // namespace ConfigurationService
