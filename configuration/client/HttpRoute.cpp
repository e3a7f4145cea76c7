#include "client/HttpRoute.h"

#include <cctype>

namespace Configuration {

namespace {

// A decimal port 1..65535.
bool parsePort(const std::string& text, std::uint16_t& port) {
    if (text.empty() || text.size() > 5) {
        return false;
    }
    unsigned long value = 0;
    for (char c : text) {
        if (!std::isdigit(static_cast<unsigned char>(c))) {
            return false;
        }
        value = value * 10 + static_cast<unsigned long>(c - '0');
    }
    if (value == 0 || value > 65535) {
        return false;
    }
    port = static_cast<std::uint16_t>(value);
    return true;
}

// Splits "host", "host:port", "[v6]" or "[v6]:port"; a bare IPv6 address has no port.
bool splitHostPort(const std::string& text, std::string& host, std::string& portText) {
    portText.clear();
    if (!text.empty() && text[0] == '[') {
        const auto close = text.find(']');
        if (close == std::string::npos) {
            return false;
        }
        host = text.substr(1, close - 1);
        if (close + 1 < text.size()) {
            if (text[close + 1] != ':') {
                return false;
            }
            portText = text.substr(close + 2);
            return !portText.empty();
        }
        return true;
    }
    const auto colon = text.find(':');
    if (colon != std::string::npos && text.find(':', colon + 1) == std::string::npos) {
        host = text.substr(0, colon);
        portText = text.substr(colon + 1);
        return !portText.empty();
    }
    host = text;
    return true;
}

std::string bracketed(const std::string& host) {
    return host.find(':') == std::string::npos ? host : "[" + host + "]";
}

// Keeps a request target on one line: control characters and spaces are percent-encoded.
std::string safeTarget(const std::string& raw) {
    static const char hex[] = "0123456789ABCDEF";
    std::string out;
    for (unsigned char c : raw) {
        if (c <= 0x20 || c == 0x7f) {
            out += '%';
            out += hex[c >> 4];
            out += hex[c & 0x0f];
        } else {
            out += static_cast<char>(c);
        }
    }
    return out.empty() ? "/" : out;
}

}  // namespace

bool ParseURL(const std::string& url, ParsedUrl& parsed) {
    const auto separator = url.find("://");
    if (separator == std::string::npos || separator == 0) {
        return false;
    }
    parsed.scheme = url.substr(0, separator);
    const auto authorityStart = separator + 3;
    auto authorityEnd = url.find_first_of("/?#", authorityStart);
    if (authorityEnd == std::string::npos) {
        authorityEnd = url.size();
    }
    parsed.authority = url.substr(authorityStart, authorityEnd - authorityStart);
    std::string portText;
    if (parsed.authority.find('@') != std::string::npos ||
        !splitHostPort(parsed.authority, parsed.host, portText) || parsed.host.empty()) {
        return false;
    }
    if (portText.empty()) {
        parsed.port = parsed.scheme == "https" ? 443 : 80;
    } else if (!parsePort(portText, parsed.port)) {
        return false;
    }
    parsed.rest = url.substr(authorityEnd);
    if (parsed.rest.empty() || parsed.rest[0] != '/') {
        parsed.rest.insert(0, "/");
    }
    return true;
}

HttpRoute RouteRequest(const std::string& server, const std::string& url) {
    HttpRoute route;
    ParsedUrl parsed;
    const bool parsable = ParseURL(url, parsed);
    route.secure = parsable && parsed.scheme == "https";
    route.connectPort = parsable ? parsed.port : 80;

    std::string serverHost;
    std::string serverPort;
    std::uint16_t port = 0;
    if (!splitHostPort(server, serverHost, serverPort)) {
        serverHost = server;  // not host[:port]: used as it stands
    } else if (!serverPort.empty()) {
        if (parsePort(serverPort, port)) {
            route.connectPort = port;
        } else {
            serverHost = server;
        }
    }
    route.connectHost = bracketed(serverHost);

    const std::string scheme = route.secure ? "https://" : "http://";
    if (parsable) {
        route.url = scheme + parsed.authority + parsed.rest;
    } else {
        route.url = scheme + route.connectHost + ":" + std::to_string(route.connectPort) + "/";
        route.requestTarget = safeTarget(url);
    }
    return route;
}

}  // namespace Configuration
