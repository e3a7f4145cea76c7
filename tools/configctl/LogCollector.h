// LogCollector: while it lives, the messages the library logs (any priority the process lets
// through) are kept instead of printed, so that configctl can show them beside the document that
// caused them. One collector at a time; the messages are taken on the thread that logs them.
#pragma once

#include <string>
#include <vector>

namespace Configctl {

class LogCollector {
public:
    LogCollector();
    ~LogCollector();
    LogCollector(const LogCollector&) = delete;
    LogCollector& operator=(const LogCollector&) = delete;

    // The messages so far, each without its trailing line break; empties the collection.
    std::vector<std::string> take();

private:
    friend class CollectingBackend;
    std::vector<std::string> m_messages;
    void* m_backend;
    unsigned long m_savedFlags;
};

}  // namespace Configctl
