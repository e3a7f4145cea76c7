// Operations: the table of the configuration service's operations by request root element. Each
// entry says whether the request needs the service ticket and whether its answer is legacy
// ("ReturnStatus" in an HTTP 200 answer) or judged by HTTP status. Filled once at start-up,
// then only read: thread-safe for reading.
#pragma once

#include <functional>
#include <map>
#include <string>

#include "OperationFailed.h"
#include "Request.h"

namespace ConfigurationService {

// One answer: HTTP status and body.
struct Reply {
    int status = 200;
    std::string body;
};

class Operations {
public:
    using Handler = std::function<Reply(const Request&)>;
    struct Entry {
        Handler handler;
        bool needsTicket = true;
        bool legacy = true;
    };

    // Adds an operation.
    void add(const std::string& name, Handler handler, bool needsTicket = true,
             bool legacy = true) {
        m_entries[name] = Entry{std::move(handler), needsTicket, legacy};
    }
    // The operation of that name, or null.
    const Entry* find(const std::string& name) const {
        auto it = m_entries.find(name);
        return it == m_entries.end() ? nullptr : &it->second;
    }

private:
    std::map<std::string, Entry> m_entries;
};

}  // namespace ConfigurationService
