// Helpers of the tests that run documents through a real in-process configuration service: the
// example documents, storing a tree as an administrator's tool would, and a repository that reads
// from one service. Free functions without shared state; each call stands alone.
#pragma once

#include <memory>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Vesk/Element.h"

namespace Configuration {
namespace ThroughService {

// The example document examples/<relative> (e.g. "site/Location.xml"), parsed.
Vesk::Element exampleDocument(const std::string& relative);

// Stores tree, in its stored form, as host's document path.
void storeTree(const HttpConfigurationClient& client, const char* host, const ACE_CString& path,
               const Vesk::Element& tree);

// A repository whose local service, also the one of host (a lower-case key), is at address.
std::unique_ptr<ConfigurationRepository> repositoryAt(const std::string& address,
                                                      const std::string& host = "testhost");

}  // namespace ThroughService
}  // namespace Configuration
