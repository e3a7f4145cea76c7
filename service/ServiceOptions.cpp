// Command-line options of configuration-service.
#include "ServiceOptions.h"

#include <functional>
#include <map>
#include <stdexcept>

namespace ConfigurationService {
namespace {

long parseNumber(const std::string& option, const std::string& text, long min, long max) {
    std::size_t used = 0;
    long value = 0;
    try {
        value = std::stol(text, &used);
    } catch (const std::exception&) {
        used = 0;
    }
    if (used != text.size() || text.empty() || value < min || value > max) {
        throw std::invalid_argument(option + " needs a number from " + std::to_string(min) +
                                    " to " + std::to_string(max) + ", not \"" + text + "\"");
    }
    return value;
}

using Setter = std::function<void(ServiceOptions&, const std::string&)>;

const std::map<std::string, Setter>& setters() {
    static const std::map<std::string, Setter> table = {
        {"--bind", [](ServiceOptions& o, const std::string& v) { o.bindAddress = v; }},
        {"--port",
         [](ServiceOptions& o, const std::string& v) {
             o.port = static_cast<int>(parseNumber("--port", v, 0, 65535));
         }},
        {"--port-file", [](ServiceOptions& o, const std::string& v) { o.portFile = v; }},
        {"--store-dir", [](ServiceOptions& o, const std::string& v) { o.storeDirectory = v; }},
        {"--host-name", [](ServiceOptions& o, const std::string& v) { o.hostName = v; }},
        {"--master", [](ServiceOptions& o, const std::string& v) { o.masterAddress = v; }},
        {"--master-name", [](ServiceOptions& o, const std::string& v) { o.masterHostName = v; }},
        {"--event-dir", [](ServiceOptions& o, const std::string& v) { o.eventDirectory = v; }},
        {"--max-body-bytes",
         [](ServiceOptions& o, const std::string& v) {
             o.maxBodyBytes =
                 static_cast<std::size_t>(parseNumber("--max-body-bytes", v, 1024, 1L << 31));
         }},
        {"--max-body-memory",
         [](ServiceOptions& o, const std::string& v) {
             o.maxBodyMemory =
                 static_cast<std::size_t>(parseNumber("--max-body-memory", v, 1024, 1L << 40));
         }},
        {"--io-threads",
         [](ServiceOptions& o, const std::string& v) {
             o.ioThreads = static_cast<int>(parseNumber("--io-threads", v, 1, 64));
         }},
        {"--threads",
         [](ServiceOptions& o, const std::string& v) {
             o.threads = static_cast<int>(parseNumber("--threads", v, 1, 1024));
         }},
        {"--request-timeout",
         [](ServiceOptions& o, const std::string& v) {
             o.requestTimeoutSeconds =
                 static_cast<int>(parseNumber("--request-timeout", v, 1, 3600));
         }},
        {"--max-connections",
         [](ServiceOptions& o, const std::string& v) {
             o.maxConnections = static_cast<int>(parseNumber("--max-connections", v, 1, 1000000));
         }},
        {"--max-connections-per-peer",
         [](ServiceOptions& o, const std::string& v) {
             o.maxConnectionsPerPeer =
                 static_cast<int>(parseNumber("--max-connections-per-peer", v, 1, 1000000));
         }},
        {"--keep-alive",
         [](ServiceOptions& o, const std::string& v) {
             o.keepAliveSeconds = static_cast<int>(parseNumber("--keep-alive", v, 0, 3600));
         }},
        {"--workflow-db", [](ServiceOptions& o, const std::string& v) { o.workflowDatabase = v; }},
        {"--max-folders-per-user",
         [](ServiceOptions& o, const std::string& v) {
             o.maxFoldersPerUser =
                 static_cast<int>(parseNumber("--max-folders-per-user", v, 1, 100000000));
         }},
        {"--max-items-per-folder",
         [](ServiceOptions& o, const std::string& v) {
             o.maxItemsPerFolder =
                 static_cast<int>(parseNumber("--max-items-per-folder", v, 1, 100000000));
         }},
        {"--log-level",
         [](ServiceOptions& o, const std::string& v) {
             if (v != "debug" && v != "info" && v != "warning" && v != "error") {
                 throw std::invalid_argument("--log-level is debug, info, warning or error");
             }
             o.logLevel = v;
         }},
    };
    return table;
}

}  // namespace

ServiceOptions ServiceOptions::parse(const std::vector<std::string>& args) {
    ServiceOptions options;
    for (std::size_t i = 0; i < args.size(); ++i) {
        std::string name = args[i];
        std::string value;
        const std::size_t equals = name.find('=');
        const bool inlineValue = name.compare(0, 2, "--") == 0 && equals != std::string::npos;
        if (inlineValue) {
            value = name.substr(equals + 1);
            name = name.substr(0, equals);
        }
        if (name == "--help" || name == "-h") {
            options.help = true;
            continue;
        }
        auto setter = setters().find(name);
        if (setter == setters().end()) {
            throw std::invalid_argument("unknown option " + name + " (see --help)");
        }
        if (!inlineValue) {
            if (i + 1 >= args.size()) {
                throw std::invalid_argument(name + " needs a value");
            }
            value = args[++i];
        }
        setter->second(options, value);
    }
    return options;
}

std::string ServiceOptions::usage(const std::string& program) {
    return "Usage: " + program +
           " [options]\n"
           "Answers the configuration protocol at "
           "/Sundrel/ConfigurationService/ConfigurationService.ashx\n"
           "with an embedded directory store, and the user-workflow protocol at\n"
           "/Sundrel/UserWorkflowService/UserWorkFlow.ashx with an SQLite database. Runs in the "
           "foreground; SIGINT or SIGTERM stops "
           "it.\n\n"
           "  --bind ADDRESS         address to listen on (default 127.0.0.1)\n"
           "  --port N               port to listen on, 0 for an ephemeral one (default 8771)\n"
           "  --port-file PATH       write the bound port to PATH once listening\n"
           "  --store-dir DIR        the store directory (default ./configuration-store)\n"
           "  --host-name NAME       this service's host name (default: the machine's)\n"
           "  --master HOST:PORT     the master's service; without it this service is the "
           "master\n"
           "  --master-name NAME     the master's host name (default: asked from the master)\n"
           "  --event-dir DIR        directory of the machine's named events "
           "($QUORVEX_EVENT_DIR)\n"
           "  --max-body-bytes N     larger request bodies are refused with 413 (default "
           "67108864)\n"
           "  --max-body-memory N    request bodies held at once, all connections together; a "
           "body\n"
           "                         that does not fit gets 503 (default 268435456)\n"
           "  --io-threads N         threads that serve the sockets (default 4)\n"
           "  --threads N            worker threads for operations that write or wait "
           "(default 16)\n"
           "  --keep-alive SECONDS   idle time before a kept-alive connection closes (default "
           "5)\n"
           "  --request-timeout S    a request head must arrive whole within S seconds of its "
           "first\n"
           "                         byte; a body gets S seconds plus one per MiB (default "
           "10)\n"
           "  --max-connections N    open connections, all peers together (default 10000)\n"
           "  --max-connections-per-peer N\n"
           "                         open connections from one peer address; further ones "
           "are\n"
           "                         closed at once (default 256)\n"
           "  --workflow-db PATH     the user-workflow database (default: the store "
           "directory's\n"
           "                         path followed by .workflow.sqlite)\n"
           "  --max-folders-per-user N\n"
           "                         folders one user may own (default 1000)\n"
           "  --max-items-per-folder N\n"
           "                         items directly in one folder (default 50000)\n"
           "  --log-level LEVEL      debug, info, warning or error (default info); debug logs "
           "every request\n"
           "  --help                 this text\n"
           "\nThe service ticket (cookie OrvelWebApplication) is the machine's, read through the "
           "ServerInterop module.\n";
}

}  // namespace ConfigurationService
