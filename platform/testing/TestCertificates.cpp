#include "TestCertificates.h"

#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace Quorvex {
namespace Testing {

namespace {

void run(const std::string& command) {
    if (std::system((command + " >/dev/null 2>&1").c_str()) != 0) {
        throw std::runtime_error("TestCertificates: failed: " + command);
    }
}

std::string quoted(const std::string& path) {
    return "'" + path + "'";
}

const char* const NEW_EC_KEY = " -newkey ec -pkeyopt ec_paramgen_curve:prime256v1 -nodes";

}  // namespace

TestCertificates TestCertificates::Create(const std::string& folder) {
    TestCertificates made;
    made.caFile = folder + "/ca.pem";
    made.server.certificateFile = folder + "/server.pem";
    made.server.privateKeyFile = folder + "/server.key";
    const std::string caKey = folder + "/ca.key";
    const std::string request = folder + "/server.csr";
    const std::string extensions = folder + "/server.ext";

    run(std::string("openssl req -x509") + NEW_EC_KEY + " -keyout " + quoted(caKey) + " -out " +
        quoted(made.caFile) + " -days 2 -subj '/CN=Quorvex Test CA'" +
        " -addext 'basicConstraints=critical,CA:TRUE'" +
        " -addext 'keyUsage=critical,keyCertSign,cRLSign'");
    run(std::string("openssl req") + NEW_EC_KEY + " -keyout " + quoted(made.server.privateKeyFile) +
        " -out " + quoted(request) + " -subj '/CN=127.0.0.1'");
    std::ofstream(extensions) << "subjectAltName=IP:127.0.0.1,DNS:localhost\n"
                                 "basicConstraints=CA:FALSE\n"
                                 "keyUsage=critical,digitalSignature,keyEncipherment\n"
                                 "extendedKeyUsage=serverAuth\n";
    run("openssl x509 -req -in " + quoted(request) + " -CA " + quoted(made.caFile) + " -CAkey " +
        quoted(caKey) + " -CAcreateserial -days 2 -extfile " + quoted(extensions) + " -out " +
        quoted(made.server.certificateFile));
    return made;
}

}  // namespace Testing
}  // namespace Quorvex
