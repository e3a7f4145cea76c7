// TestCertificates: a throw-away certificate authority and a server certificate it signed, for
// TLS tests against RecordingHttpServer. The server certificate names 127.0.0.1 and localhost.
// Made with the openssl command into a folder the caller owns (e.g. a ScratchDir).
#pragma once

#include <string>

#include "RecordingHttpServer.h"

namespace Quorvex {
namespace Testing {

struct TestCertificates {
    std::string caFile;  // the authority's certificate (PEM), to trust in the client
    TlsIdentity server;  // the server's certificate and key

    // Creates the files in folder; throws std::runtime_error when openssl fails.
    static TestCertificates Create(const std::string& folder);
};

}  // namespace Testing
}  // namespace Quorvex
