// HttpRoute: where one request of HttpConfigurationClient goes. The connection is always opened to
// the client's server (its port when the server text carries one), whatever host the URL names;
// the URL only gives the scheme (TLS exactly when it is "https"), the default port, the Host
// header and the request target. A URL that does not parse still goes to the server, port 80.
// Pure functions of their arguments; thread-safe.
#pragma once

#include <cstdint>
#include <string>

namespace Configuration {

// The parts of an absolute URL "scheme://host[:port][/path...]".
struct ParsedUrl {
    std::string scheme;
    std::string authority;  // host[:port] as written
    std::string host;       // without brackets for IPv6
    std::uint16_t port = 0;
    std::string rest;  // path, query and fragment; at least "/"
};

// Splits url; false when it is not an absolute URL with a host and a valid port.
bool ParseURL(const std::string& url, ParsedUrl& parsed);

struct HttpRoute {
    bool secure = false;      // TLS
    std::string connectHost;  // the server's host (IPv6 in brackets)
    std::uint16_t connectPort = 0;
    std::string url;            // what the HTTP library is given (scheme http or https)
    std::string requestTarget;  // empty: the URL's own path; else sent as the request target
};

// The route of a request for url sent by a client of server.
HttpRoute RouteRequest(const std::string& server, const std::string& url);

}  // namespace Configuration
