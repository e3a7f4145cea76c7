// ToolOptions: the command line of configctl: global flags (--server, --host, --https, --master,
// --module-type), then a command and its arguments. A plain value.
#pragma once

#include <string>
#include <vector>

namespace Configctl {

struct ToolOptions {
    static constexpr const char* kServerVariable = "QUORVEX_CONFIGURATION_SERVER";
    static constexpr const char* kDefaultServer = "127.0.0.1:8771";

    std::string server;  // "host:port"; default $QUORVEX_CONFIGURATION_SERVER or kDefaultServer
    std::string host;    // the host whose documents are meant; empty: the service's own
    bool https = false;
    bool viaMaster = false;  // put: "StoreMaster" instead of "Store"
    int moduleType = -1;     // hosts: only hosts running this module type (-1: all)
    bool dot = false;        // topology: a Graphviz graph instead of text
    bool help = false;
    bool version = false;  // --version: print the version and stop
    bool json = false;     // --output json: list commands print JSON
    std::string command;
    std::vector<std::string> arguments;

    // Parses the arguments (without the program name); throws std::invalid_argument with a
    // one-line message.
    static ToolOptions parse(const std::vector<std::string>& args);
    // The --help text.
    static std::string usage();
};

}  // namespace Configctl
