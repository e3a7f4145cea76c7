// Operations: the table of the configuration service's operations by request root element. Each
// entry says whether the request needs the service ticket and whether its answer is legacy
// ("ReturnStatus" in an HTTP 200 answer) or judged by HTTP status. Filled once at start-up,
// then only read: thread-safe for reading.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <utility>

#include "OperationFailed.h"
#include "Request.h"

namespace ConfigurationService {

// One answer: HTTP status and body. A large body may end in a shared text that never changes
// (kept once for every answer that carries it) and a tail: the answer's text is then body,
// *shared and tail in that order, sent without joining them.
struct Reply {
    Reply() = default;
    // An answer of one text.
    Reply(int status, std::string body) : status(status), body(std::move(body)) {}

    int status = 200;
    std::string body;
    std::shared_ptr<const std::string> shared;
    std::string tail;

    // The length of the answer's text.
    std::size_t size() const { return body.size() + (shared ? shared->size() : 0) + tail.size(); }
    // The answer's text, joined.
    std::string text() const { return shared ? body + *shared + tail : body + tail; }
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
