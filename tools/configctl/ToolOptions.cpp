// configctl's command line.
#include "ToolOptions.h"

#include <cstdlib>
#include <stdexcept>

namespace Configctl {
namespace {

// The value of an option given as "--name value" or "--name=value".
bool takeValue(const std::vector<std::string>& args, std::size_t& i, const std::string& name,
               std::string& value) {
    const std::string& arg = args[i];
    if (arg == name) {
        if (i + 1 >= args.size()) {
            throw std::invalid_argument(name + " needs a value");
        }
        value = args[++i];
        return true;
    }
    if (arg.compare(0, name.size() + 1, name + "=") == 0) {
        value = arg.substr(name.size() + 1);
        return true;
    }
    return false;
}

int parseModuleType(const std::string& text) {
    char* end = nullptr;
    const long value = std::strtol(text.c_str(), &end, 10);
    if (text.empty() || *end != '\0' || value < 0 || value > 1000000) {
        throw std::invalid_argument("--module-type needs a number, not \"" + text + "\"");
    }
    return static_cast<int>(value);
}

}  // namespace

ToolOptions ToolOptions::parse(const std::vector<std::string>& args) {
    ToolOptions options;
    const char* fromEnvironment = std::getenv(kServerVariable);
    options.server =
        fromEnvironment != nullptr && *fromEnvironment ? fromEnvironment : kDefaultServer;
    for (std::size_t i = 0; i < args.size(); ++i) {
        std::string value;
        const std::string& arg = args[i];
        if (arg == "--help" || arg == "-h") {
            options.help = true;
        } else if (arg == "--version") {
            options.version = true;
        } else if (arg == "--https") {
            options.https = true;
        } else if (arg == "--dot") {
            options.dot = true;
        } else if (arg == "--master") {
            options.viaMaster = true;
        } else if (takeValue(args, i, "--server", value)) {
            options.server = value;
        } else if (takeValue(args, i, "--host", value)) {
            options.host = value;
        } else if (takeValue(args, i, "--output", value)) {
            if (value != "json" && value != "text") {
                throw std::invalid_argument("--output is json or text, not \"" + value + "\"");
            }
            options.json = value == "json";
        } else if (takeValue(args, i, "--module-type", value)) {
            options.moduleType = parseModuleType(value);
        } else if (arg.compare(0, 2, "--") == 0) {
            throw std::invalid_argument("unknown option " + arg + " (see --help)");
        } else if (options.command.empty()) {
            options.command = arg;
        } else {
            options.arguments.push_back(arg);
        }
    }
    if (options.command.empty() && !options.help && !options.version) {
        throw std::invalid_argument("no command given (see --help)");
    }
    return options;
}

std::string ToolOptions::usage() {
    return "Usage: configctl [options] COMMAND [ARGUMENTS]\n"
           "Administers a configuration service through the configuration library's client.\n\n"
           "Commands:\n"
           "  hosts                       list the hosts that registered services\n"
           "  items                       list the documents of --host (\"*\": of every host)\n"
           "  get NAME                    print a document as indented XML\n"
           "  put NAME FILE               store the XML document in FILE\n"
           "  exists NAME                 print \"yes\" or \"no\"\n"
           "  time NAME                   print the document's last-modified time\n"
           "  register SERVICE [CONNECTION]  register a service of --host\n"
           "  unregister SERVICE          unregister a service of the service's own host\n"
           "  changed | refresh | restart send that signal to the service\n"
           "  info                        print the service's server information\n"
           "  dicom-nodes                 list the remote DICOM nodes the site's documents name\n"
           "                              (export destinations, query archives, commitment nodes,\n"
           "                              known sources): document, role, AE title, host, port\n"
           "  check                       read every DICOM document of --host through its class;\n"
           "                              report incomplete reads, logged failures and site\n"
           "                              mistakes (AE titles, ports, duplicate AE titles,\n"
           "                              undefined destinations); exit status 2 if any\n"
           "  whoami                      print the service's host name and its master's\n"
           "  sop [NAME]                  print the SOP service document (default\n"
           "                              BrimmetServer\\SOPServiceConfiguration) resolved: per\n"
           "                              service the transfer syntaxes it accepts\n"
           "  topology [--dot]            print the storage topology: each location's chain as\n"
           "                              stored and resolved to stacks, the stacks, targets, "
           "cache\n"
           "                              and tape servers; --dot: as a Graphviz graph\n"
           "                              (configctl topology --dot | dot -Tsvg > site.svg)\n"
           "  archive                     print the tape archive (passwords masked)\n"
           "  processes                   print the processes table of --host: process, module\n"
           "                              type, state, executable, services enabled/disabled\n"
           "  services PROCESS            print the service-configurator text PROCESS of --host\n"
           "                              loads (one directive per enabled service)\n"
           "  users [TYPE]                list the user-workflow users (of TYPE): id, type,\n"
           "                              logged in or out, on call, name\n"
           "  folders USER                print USER's inbox and master folder as a tree: per\n"
           "                              node its name, id, kind, sharing and item count\n\n"
           "Options:\n"
           "  --server HOST:PORT  the configuration service (default $QUORVEX_CONFIGURATION_SERVER"
           " or 127.0.0.1:8771)\n"
           "  --host NAME         the host the documents belong to (default: the service's own)\n"
           "  --master            put: store through StoreMaster (reaches the master)\n"
           "  --module-type N     hosts: only hosts that registered a module of type N\n"
           "  --dot               topology: print a Graphviz graph\n"
           "  --https             talk TLS\n"
           "  --help              this text\n"
           "  --output FORMAT     text (default) or json (for the list commands only)\n"
           "  --version           print configctl's version\n\n"
           "The machine's service ticket ($QUORVEX_SERVICE_TICKET_FILE, default\n"
           "/etc/quorvex/service-ticket, as for the library) is sent as cookie "
           "OrvelWebApplication.\n"
           "On failure one line on stderr says why.\n\n"
           "JSON output (--output json):\n"
           "  One JSON value on one line, ASCII only (other characters as \\uXXXX), keys in\n"
           "  camelCase, absent values null, passwords masked as in the text. hosts: an array\n"
           "  of names; items, users, dicom-nodes, services: an array of objects; folders,\n"
           "  processes, sop, topology, archive, check: one object. Notes on incomplete\n"
           "  documents go to stderr. Other commands refuse json (exit status 6).\n\n"
           "Exit status:\n"
           "  0  success\n"
           "  1  any other failure\n"
           "  2  check: the site has mistakes\n"
           "  3  not found: the document or path does not exist\n"
           "  4  access denied: the service refused the ticket, or no usable ticket\n"
           "  5  unreachable: no answer from the service\n"
           "  6  bad input: bad options or arguments, unreadable or malformed input file\n";
}

}  // namespace Configctl
