// Request bodies parsed with pugixml.
#include "Request.h"

#include <cstring>
#include <pugixml.hpp>

namespace ConfigurationService {
namespace {

// A request holds a root and a few parameters; more markup than this is refused before parsing,
// which keeps the parsed tree of any body a small fraction of the body's own size.
constexpr std::size_t kMaxMarkup = 1024;

// Whether text holds more than limit tags (stops counting there).
bool tagsBeyond(const std::string& text, std::size_t limit) {
    const char* at = text.data();
    const char* const end = at + text.size();
    std::size_t tags = 0;
    while ((at = static_cast<const char*>(
                std::memchr(at, '<', static_cast<std::size_t>(end - at)))) != nullptr) {
        if (++tags > limit) {
            return true;
        }
        ++at;
    }
    return false;
}

// The text of a parameter element; nested elements are refused.
std::string textOf(const pugi::xml_node& node) {
    std::string text;
    for (pugi::xml_node child : node.children()) {
        if (child.type() == pugi::node_element) {
            throw BadRequest(std::string("element ") + node.name() + " holds element " +
                             child.name() + "; parameters hold only text");
        }
        if (child.type() == pugi::node_pcdata || child.type() == pugi::node_cdata) {
            text += child.value();
        }
    }
    return text;
}

}  // namespace

Request Request::parse(std::string& body) {
    if (tagsBeyond(body, kMaxMarkup)) {
        throw BadRequest("the request holds more than " + std::to_string(kMaxMarkup) +
                         " tags; a request is one element with a few parameters");
    }
    pugi::xml_document document;
    const unsigned options = pugi::parse_default & ~pugi::parse_eol;
    const pugi::xml_parse_result result =
        document.load_buffer_inplace(&body[0], body.size(), options, pugi::encoding_utf8);
    if (!result) {
        throw BadRequest(std::string("malformed XML request at offset ") +
                         std::to_string(result.offset) + ": " + result.description());
    }
    pugi::xml_node root = document.document_element();
    if (!root) {
        throw BadRequest("the request has no root element");
    }
    for (pugi::xml_node after = root.next_sibling(); after; after = after.next_sibling()) {
        if (after.type() == pugi::node_element) {
            throw BadRequest("the request has more than one root element");
        }
    }
    Request request;
    request.m_operation = root.name();
    for (pugi::xml_node child : root.children()) {
        if (child.type() == pugi::node_element && request.m_fields.count(child.name()) == 0) {
            request.m_fields.emplace(child.name(), textOf(child));
        }
    }
    return request;
}

const std::string& Request::required(const std::string& name) const {
    auto it = m_fields.find(name);
    if (it == m_fields.end()) {
        throw BadRequest(m_operation + " needs the element " + name);
    }
    return it->second;
}

std::string Request::optional(const std::string& name, const std::string& fallback) const {
    auto it = m_fields.find(name);
    return it == m_fields.end() ? fallback : it->second;
}

}  // namespace ConfigurationService
