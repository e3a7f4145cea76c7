#include "TestCertificates.h"

#include <cstdlib>
#include <stdexcept>

namespace Quorvex {
namespace Testing {

namespace {

// Makes a new EC key and a certificate valid for two days, as args say; throws
// std::runtime_error when openssl fails.
void newCertificate(const std::string& args) {
    const std::string command =
        "openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:prime256v1 -nodes -days 2 " + args;
    if (std::system((command + " >/dev/null 2>&1").c_str()) != 0) {
        throw std::runtime_error("TestCertificates: failed: " + command);
    }
}

std::string quoted(const std::string& path) {
    return "'" + path + "'";
}

}  // namespace

TestCertificates TestCertificates::Create(const std::string& folder) {
    TestCertificates made;
    made.caFile = folder + "/ca.pem";
    made.server.certificateFile = folder + "/server.pem";
    made.server.privateKeyFile = folder + "/server.key";
    const std::string caKey = folder + "/ca.key";
    newCertificate("-keyout " + quoted(caKey) + " -out " + quoted(made.caFile) +
                   " -subj '/CN=Quorvex Test CA' -addext 'basicConstraints=critical,CA:TRUE'"
                   " -addext 'keyUsage=critical,keyCertSign,cRLSign'");
    newCertificate("-keyout " + quoted(made.server.privateKeyFile) + " -out " +
                   quoted(made.server.certificateFile) + " -subj '/CN=127.0.0.1' -CA " +
                   quoted(made.caFile) + " -CAkey " + quoted(caKey) +
                   " -addext 'subjectAltName=IP:127.0.0.1,DNS:localhost'"
                   " -addext 'basicConstraints=CA:FALSE'"
                   " -addext 'keyUsage=critical,digitalSignature,keyEncipherment'"
                   " -addext 'extendedKeyUsage=serverAuth'");
    return made;
}

}  // namespace Testing
}  // namespace Quorvex
