// RawPost: sends one body to a configuration service exactly as given (any bytes, any size,
// with or without the ticket cookie) and returns status and body, for tests of bad input.
// Stateless; thread-safe.
#pragma once

#include <string>

namespace ServiceTesting {

struct RawAnswer {
    int status = 0;  // 0: no answer
    std::string body;
};

// POSTs body to the service path on 127.0.0.1:port; the cookie header is sent when not empty.
RawAnswer rawPost(
    int port, const std::string& body, const std::string& cookie,
    const std::string& path = "/Sundrel/ConfigurationService/ConfigurationService.ashx");

// An item request: <operation><Host>host</Host><ConfigurationName>name</ConfigurationName>, then
// rest as given, then the closing tag.
std::string itemBody(const std::string& operation, const std::string& host, const std::string& name,
                     const std::string& rest = "");

// The text of the first <tag>...</tag> in text, or "<none>".
std::string elementText(const std::string& text, const std::string& tag);

}  // namespace ServiceTesting
