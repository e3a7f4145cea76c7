// Configuration::ServiceLocation: where a process finds the configuration services.
//
// By default the repository talks to the configuration service of this machine on
// 127.0.0.1:8771 over HTTP, and to another host's service on <host>:8771. Environment variables
// change that (read once, when the repository is created):
//   QUORVEX_CONFIGURATION_SERVER  address of this machine's service ("127.0.0.1:9000")
//   QUORVEX_CONFIGURATION_HOSTS   addresses of named hosts: "master=10.1.2.3:8771,slave2=..."
//   QUORVEX_CONFIGURATION_PORT    the port for hosts without an address (default 8771)
//   QUORVEX_CONFIGURATION_HTTPS   "1": talk TLS
//   QUORVEX_CONFIGURATION_STORE   a directory: embedded mode, no service at all (see README)
// A plain value; thread-safe to read.
#pragma once

#include <ace/SString.h>

#include <map>
#include <string>

#include "Configuration/Export.h"

namespace Configuration {

struct CONFIGURATION_API ServiceLocation {
    static constexpr unsigned short kDefaultPort = 8771;

    ACE_CString localServer;                     // this machine's service
    std::map<std::string, std::string> servers;  // lower-case host name to address
    unsigned short port = kDefaultPort;
    bool useHttps = false;
    ACE_CString storeDirectory;  // not empty: embedded mode

    // The settings from the environment (through the machine seam), defaults for the rest.
    static ServiceLocation fromEnvironment();
    // The address of host's service: its entry in servers, else this machine's own service when
    // host names this machine, else host:port.
    ACE_CString serverFor(const ACE_CString& host) const;
};

}  // namespace Configuration
