#include "Configuration/ServiceLocation.h"

#include <cstdlib>
#include <sstream>

#include "Quorvex/Host.h"

namespace Configuration {
namespace {

bool env(const char* name, std::string& value) {
    ACE_CString text;
    if (!Quorvex::GetEnvironmentVariable(name, text) || text.length() == 0) {
        return false;
    }
    value = text.c_str();
    return true;
}

// "a=1.2.3.4:80,b=host:81" into the map; entries without "=" are ignored.
void parseServers(const std::string& text, std::map<std::string, std::string>& servers) {
    std::istringstream in(text);
    std::string entry;
    while (std::getline(in, entry, ',')) {
        const std::string::size_type eq = entry.find('=');
        if (eq != std::string::npos && eq > 0) {
            servers[Quorvex::HostKey(entry.substr(0, eq))] = entry.substr(eq + 1);
        }
    }
}

}  // namespace

ServiceLocation ServiceLocation::fromEnvironment() {
    ServiceLocation location;
    std::string value;
    if (env("QUORVEX_CONFIGURATION_PORT", value)) {
        const long port = std::strtol(value.c_str(), nullptr, 10);
        if (port > 0 && port < 65536) {
            location.port = static_cast<unsigned short>(port);
        }
    }
    location.localServer = ("127.0.0.1:" + std::to_string(location.port)).c_str();
    if (env("QUORVEX_CONFIGURATION_SERVER", value)) {
        location.localServer = value.c_str();
    }
    if (env("QUORVEX_CONFIGURATION_HOSTS", value)) {
        parseServers(value, location.servers);
    }
    location.useHttps = env("QUORVEX_CONFIGURATION_HTTPS", value) && value == "1";
    if (env("QUORVEX_CONFIGURATION_STORE", value)) {
        location.storeDirectory = value.c_str();
    }
    return location;
}

ACE_CString ServiceLocation::serverFor(const ACE_CString& host) const {
    const auto it = servers.find(Quorvex::HostKey(host.c_str()));
    if (it != servers.end()) {
        return it->second.c_str();
    }
    if (Quorvex::HostNamesEquivalent(host, Quorvex::GetHostName(false))) {
        return localServer;
    }
    return host + ":" + std::to_string(port).c_str();
}

}  // namespace Configuration
