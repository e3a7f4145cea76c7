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
    std::size_t maxBodyMemory = 256u << 20;  // request bodies held at once, all connections
    int ioThreads = 4;                       // threads that run the sockets (never block)
    int threads = 16;                        // worker threads for operations that may block
    int keepAliveSeconds = 5;                // idle time between requests on one connection
    int requestTimeoutSeconds = 10;          // a whole request head; bodies get more by size
    int maxConnections = 10000;              // open connections, all peers
    int maxConnectionsPerPeer = 256;         // open connections from one peer address
    // The user-workflow database; empty: the store directory's path + ".workflow.sqlite".
    std::string workflowDatabase;
    int maxFoldersPerUser = 1000;   // folders one user may own; beyond: error code "42794"
    int maxItemsPerFolder = 50000;  // items directly in one folder; beyond: error code "42795"
    std::string logLevel = "info";  // debug, info, warning or error
    bool help = false;

    // Parses the arguments (without the program name); throws std::invalid_argument with a
    // one-line message on a bad option.
    static ServiceOptions parse(const std::vector<std::string>& args);
    // The --help text.
    static std::string usage(const std::string& program);
};

}  // namespace ConfigurationService
