// Request: one parsed request of the configuration service. A request body is a small XML
// document whose root element names the operation and whose child elements carry the
// parameters as text ("<Store><Host>h</Host>...</Store>"). A plain value.
#pragma once

#include <map>
#include <string>

#include "BadRequest.h"

namespace ConfigurationService {

class Request {
public:
    // Parses body (which it may modify); throws BadRequest when it is not well-formed XML with
    // one root element whose children hold only text, or holds more than 1024 tags.
    static Request parse(std::string& body);

    // The root element's name.
    const std::string& operation() const { return m_operation; }
    // Whether the parameter element is present.
    bool has(const std::string& name) const { return m_fields.count(name) != 0; }
    // The text of a parameter element; throws BadRequest when it is missing.
    const std::string& required(const std::string& name) const;
    // The text of a parameter element, or fallback when it is missing.
    std::string optional(const std::string& name, const std::string& fallback = "") const;

private:
    std::string m_operation;
    std::map<std::string, std::string> m_fields;  // the first element of each name
};

}  // namespace ConfigurationService
