// Raw HTTP requests to a service under test, over cpp-httplib's client.
#include "RawPost.h"

#include <httplib.h>

namespace ServiceTesting {

RawAnswer rawPost(int port, const std::string& body, const std::string& cookie,
                  const std::string& path) {
    httplib::Client client("127.0.0.1", port);
    client.set_read_timeout(30, 0);
    client.set_tcp_nodelay(true);
    httplib::Headers headers;
    if (!cookie.empty()) {
        headers.emplace("Cookie", cookie);
    }
    const httplib::Result result = client.Post(path.c_str(), headers, body, "text/xml");
    if (!result) {
        return RawAnswer{};
    }
    return RawAnswer{result->status, result->body};
}

std::string elementText(const std::string& text, const std::string& tag) {
    const std::string open = "<" + tag + ">";
    const std::size_t start = text.find(open);
    if (start == std::string::npos) {
        return "<none>";
    }
    const std::size_t end = text.find("</" + tag + ">", start);
    if (end == std::string::npos) {
        return "<none>";
    }
    return text.substr(start + open.size(), end - start - open.size());
}

std::string itemBody(const std::string& operation, const std::string& host, const std::string& name,
                     const std::string& rest) {
    return "<" + operation + "><Host>" + host + "</Host><ConfigurationName>" + name +
           "</ConfigurationName>" + rest + "</" + operation + ">";
}

}  // namespace ServiceTesting
