// StorageTopologyReport: the site's storage topology as an administrator looks at it, built from
// the stored strategy, location, queue and tape-archive documents: per location its servers and
// its chain, as stored ("[host]->[host]") and with the keywords replaced by the stacks and cache
// they resolve to now; the stacks with their state and mirrors; the persistent, retired and cache
// targets; and the tape servers with the stacks archived to them. As text, or as a Graphviz graph
// (configctl topology --dot | dot -Tsvg), or as JSON. Passwords are never printed. Not thread-safe.
#pragma once

#include <ostream>
#include <string>

#include "Configuration/KelArchiveConfiguration.h"
#include "Configuration/LocationConfiguration.h"
#include "Configuration/MSMQCommonConfiguration.h"
#include "Configuration/StrategyConfiguration.h"

namespace Configctl {

// The documents a topology is drawn from.
struct StorageTopology {
    Configuration::MSMQCommonConfiguration queues;
    Configuration::LocationConfiguration locations;
    Configuration::StrategyConfiguration strategy;
    Configuration::KelArchiveConfiguration archive;
};

// The chain of location with each link as the topology resolves it now ("[stack]", "[cache
// host]", "[host]"; "[?]" when it cannot be resolved, "[!no active stack]" on a site that has
// storage stacks but none active). The queries' documents come from the process's topology source.
std::string resolvedChain(const StorageTopology& topology,
                          const Configuration::ChainUtils::Chain& chain);
// "main", "remote" or "remote over WAN".
const char* locationTypeName(const Configuration::LocationProfile& profile);
// "active", "standby", or what else the stack is ("retired", "unused").
std::string stackState(const Configuration::StrategyStack& stack);
// The text report.
void printTopology(const StorageTopology& topology, std::ostream& out);
// The Graphviz graph.
void printTopologyDot(const StorageTopology& topology, std::ostream& out);
// The text report as one JSON object: locations, stacks, targets and tape servers.
void printTopologyJson(const StorageTopology& topology, std::ostream& out);
// The tape archive: servers (password masked), nodes and archived stacks.
void printArchive(const Configuration::KelArchiveConfiguration& archive, std::ostream& out);
// The tape archive as one JSON object, the passwords masked.
void printArchiveJson(const Configuration::KelArchiveConfiguration& archive, std::ostream& out);

// What a password is printed as.
constexpr const char* kMaskedPassword = "********";
// Replaces the text of every element of tree that holds a credential by kMaskedPassword.
void maskCredentials(Vesk::Element& tree);

}  // namespace Configctl
