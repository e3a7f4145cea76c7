// ServiceOptions: the settings of one configuration-service instance, read from the command
// line. Several instances can run on one machine, each with its own port, store directory, host
// identity and event directory. A plain value.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace ConfigurationService {

struct ServiceOptions {
    std::string bindAddress = "127.0.0.1";
    int port = 8771;       // 0: an ephemeral port
    std::string portFile;  // where to write the bound port once listening
    std::string storeDirectory = "configuration-store";
    std::string hostName;        // empty: this machine's short host name
    std::string masterAddress;   // "host:port" of the master's service; empty: we are master
    std::string masterHostName;  // the master's host name, if known in advance
    std::string eventDirectory;  // sets $QUORVEX_EVENT_DIR for the change event
    std::size_t maxBodyBytes = 64u << 20;
    int threads = 64;  // worker threads; each serves one connection at a time
    int keepAliveSeconds = 5;
    std::string logLevel = "info";  // debug, info, warning or error
    bool help = false;

    // Parses the arguments (without the program name); throws std::invalid_argument with a
    // one-line message on a bad option.
    static ServiceOptions parse(const std::vector<std::string>& args);
    // The --help text.
    static std::string usage(const std::string& program);
};

}  // namespace ConfigurationService
