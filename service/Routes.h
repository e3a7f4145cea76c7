// Routes: the service paths the HTTP front answers, each with the handler that answers the
// bodies POSTed to it. A RouteHandler answers one body and says whether a body may run on a
// socket thread (answers from memory at once) or must go to the worker pool. Filled once before
// the front starts, then only read: thread-safe for reading; the handlers must outlive the front.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "Operations.h"

namespace ConfigurationService {

class RouteHandler {
public:
    virtual ~RouteHandler() = default;
    // The answer to body (which may be modified), sent with the given "Cookie" header values,
    // from peer (for the log). Thread-safe.
    virtual Reply dispatch(std::string& body, const std::vector<std::string>& cookieHeaders,
                           const std::string& peer) const = 0;
    // Whether body answers from memory without waiting, so that it may run on a socket thread.
    virtual bool isQuick(const std::string& body) const = 0;
};

class Routes {
public:
    // Answers POSTs to path with handler.
    void add(const std::string& path, const RouteHandler& handler) {
        m_routes.emplace_back(path, &handler);
    }
    // The handler of path, or null.
    const RouteHandler* find(const std::string& path) const {
        for (const auto& route : m_routes) {
            if (route.first == path) {
                return route.second;
            }
        }
        return nullptr;
    }
    // The paths, separated by " or " (for the answer to an unknown path).
    std::string describe() const {
        std::string text;
        for (const auto& route : m_routes) {
            text += (text.empty() ? "" : " or ") + route.first;
        }
        return text;
    }

private:
    std::vector<std::pair<std::string, const RouteHandler*>> m_routes;
};

}  // namespace ConfigurationService
