#include "ThroughServiceSupport.h"

#include <fstream>
#include <sstream>

#include "Configuration/StoredForm.h"
#include "Vesk/XmlUtils.h"
#include "repository/HttpServiceConnection.h"

namespace Configuration {
namespace ThroughService {

Vesk::Element exampleDocument(const std::string& relative) {
    std::ifstream in(std::string(QUORVEX_EXAMPLES) + "/" + relative, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    Vesk::Element tree;
    Vesk::XmlUtils::parse(text.str().data(), text.str().size(), tree);
    return tree;
}

void storeTree(const HttpConfigurationClient& client, const char* host, const ACE_CString& path,
               const Vesk::Element& tree) {
    const std::string bytes = StoredForm::encode(tree);
    client.store(host, path, reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size(),
                 "");
}

std::unique_ptr<ConfigurationRepository> repositoryAt(const std::string& address,
                                                      const std::string& host) {
    ServiceLocation location;
    location.localServer = address.c_str();
    location.servers[host] = address;
    return std::make_unique<ConfigurationRepository>(
        std::make_shared<HttpServiceConnector>(location));
}

}  // namespace ThroughService
}  // namespace Configuration
