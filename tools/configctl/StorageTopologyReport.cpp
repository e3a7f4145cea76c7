#include "StorageTopologyReport.h"

#include <map>
#include <set>
#include <string>

#include "Configuration/MSMQConfiguration.h"
#include "Vesk/MultiElementValue.h"
#include "Vesk/MultiValue.h"
#include "Vesk/SingleValue.h"

namespace Configctl {
namespace {

using Configuration::LocationProfile;
using Configuration::MSMQConfiguration;
using Configuration::ChainUtils::Chain;
using Configuration::ChainUtils::Link;

const char* const kCredentialKeys[] = {"TivoliServerAccessPassword", "MasterDatabasePassword"};

std::string text(const ACE_CString& s) {
    return std::string(s.c_str(), s.length());
}

// What one link resolves to: its kind and the name to show.
struct Resolved {
    enum Kind { Stack, Cache, Host, Unknown } kind;
    std::string name;
};

Resolved resolve(const StorageTopology& topology, const Link& link) {
    short type = 0;
    ACE_CString value, prefix, suffix;
    try {
        if (!topology.queues.translateLinkDefinitionWithStackUid(link.getDefinition(), type, value,
                                                                 prefix, suffix)) {
            return {Resolved::Unknown, "?"};
        }
    } catch (const std::exception&) {
        return {Resolved::Unknown, "!no active stack"};
    }
    switch (type) {
        case Configuration::ChainUtils::ActiveStack:
            return {Resolved::Stack, text(value)};
        case Configuration::ChainUtils::Cache:
            return {Resolved::Cache, text(MSMQConfiguration::HostFromQueue(value))};
        default:
            return {Resolved::Host, text(MSMQConfiguration::HostFromQueue(value))};
    }
}

// A Graphviz identifier: the text quoted, with quotes and backslashes escaped.
std::string quoted(const std::string& s) {
    std::string q = "\"";
    for (char c : s) {
        if (c == '"' || c == '\\') {
            q += '\\';
        }
        q += c;
    }
    return q + "\"";
}

void maskIn(Vesk::MultiElementValue& children);

void maskValue(Vesk::Element& element) {
    if (!element.hasValue()) {
        return;
    }
    if (element.value().kind() == Vesk::Value::Kind::MultiElement) {
        maskIn(element.getMultiElement());
    }
}

void maskIn(Vesk::MultiElementValue& children) {
    for (Vesk::Element& child : children) {
        bool credential = false;
        for (const char* key : kCredentialKeys) {
            credential = credential || child.key() == key;
        }
        if (credential) {
            child.addSingle().assign(kMaskedPassword);
        } else {
            maskValue(child);
        }
    }
}

}  // namespace

const char* locationTypeName(const LocationProfile& profile) {
    switch (profile.getType()) {
        case LocationProfile::MainLocation:
            return "main";
        case LocationProfile::RemoteLocation:
            return "remote";
        default:
            return "remote over WAN";
    }
}

std::string stackState(const Configuration::StrategyStack& stack) {
    std::string state = stack.getIsStackActive() == 1 ? "active" : "";
    if (stack.getIsStackRetired() != 0) {
        state += state.empty() ? "retired" : ", retired";
    }
    if (stack.getIsStackUnused() != 0) {
        state += state.empty() ? "unused" : ", unused";
    }
    return state.empty() ? "standby" : state;
}

std::string resolvedChain(const StorageTopology& topology, const Chain& chain) {
    if (chain.empty()) {
        return "EMPTY CHAIN";
    }
    std::string line;
    for (const Link& link : chain) {
        line += (line.empty() ? "[" : "->[") + resolve(topology, link).name + "]";
    }
    return line;
}

void printTopology(const StorageTopology& topology, std::ostream& out) {
    const auto& chains = topology.queues.getLocationMigrationChains();
    for (const LocationProfile& profile : topology.locations.getLocationProfiles()) {
        out << "Location " << text(profile.getProfileName()) << " (" << locationTypeName(profile)
            << ", " << (profile.IsWAN() ? "WAN" : "LAN") << ")\n  servers  ";
        for (const ACE_CString& server : profile.getLocalServers()) {
            out << text(server) << (&server == &profile.getLocalServers().back() ? "" : ", ");
        }
        out << "\n";
        const auto chain = chains.find(profile.getProfileName());
        if (chain == chains.end()) {
            out << "  chain    (none)\n";
            continue;
        }
        out << "  chain    " << Configuration::ChainUtils::chainToString(chain->second).c_str()
            << "\n  resolved " << resolvedChain(topology, chain->second) << "\n";
    }
    out << "Stacks\n";
    for (const auto& stack : topology.strategy.getAvailableStacks()) {
        ACE_CString mirror;
        topology.queues.getMirrorStackForPersistentStack(stack.getStackUid(), mirror);
        out << "  " << text(stack.getStackUid()) << "  " << stackState(stack)
            << (mirror.length() != 0 ? "  mirror " + text(mirror) : std::string()) << "\n";
    }
    for (const auto& target : topology.queues.getPersistentTargets()) {
        out << "Persistent target  " << text(target.first) << "  mirror " << text(target.second)
            << "\n";
    }
    for (const auto& target : topology.queues.getRetiredPersistentTargets()) {
        out << "Retired target     " << text(target.first) << "  mirror " << text(target.second)
            << "\n";
    }
    for (const ACE_CString& cache : topology.queues.getCacheMigrationTargets()) {
        out << "Cache target       " << text(cache) << "\n";
    }
    for (const auto& server : topology.archive.getTivoliServers()) {
        out << "Tape server        " << text(server.first) << ":"
            << server.second.getTivoliStorageManagerPort() << "\n";
    }
}

void printTopologyDot(const StorageTopology& topology, std::ostream& out) {
    out << "digraph storage {\n  rankdir=LR;\n  node [shape=box, fontname=\"Helvetica\"];\n"
           "  edge [fontname=\"Helvetica\", fontsize=10];\n";
    std::set<std::string> mirrors;
    for (const auto& pair : topology.queues.getMirrors()) {
        mirrors.insert(text(pair.second));
    }
    for (const auto& stack : topology.strategy.getAvailableStacks()) {
        const bool active = stack.getIsStackActive() == 1;
        const bool retired = stack.getIsStackRetired() != 0;
        out << "  " << quoted("stack " + text(stack.getStackUid())) << " [shape=box3d, label="
            << quoted("stack\n" + text(stack.getStackUid()) + "\n" + stackState(stack))
            << ", style=filled, fillcolor="
            << (active    ? "palegreen"
                : retired ? "gray80"
                          : "lightyellow")
            << "];\n";
    }
    for (const auto& pair : topology.queues.getMirrors()) {
        out << "  " << quoted("stack " + text(pair.second))
            << " [shape=box3d, label=" << quoted("mirror\n" + text(pair.second))
            << ", style=filled, fillcolor=lightblue];\n"
            << "  " << quoted("stack " + text(pair.first)) << " -> "
            << quoted("stack " + text(pair.second)) << " [style=dashed, label=\"mirror\"];\n";
    }
    for (const auto& target : topology.queues.getRetiredPersistentTargets()) {
        out << "  " << quoted("stack " + text(MSMQConfiguration::HostFromQueue(target.first)))
            << " [color=gray40, fontcolor=gray40];\n";
    }
    for (const ACE_CString& cache : topology.queues.getCacheMigrationTargets()) {
        const std::string host = text(MSMQConfiguration::HostFromQueue(cache));
        out << "  " << quoted("host " + host)
            << " [shape=cylinder, label=" << quoted("cache\n" + host) << "];\n";
    }
    const auto& chains = topology.queues.getLocationMigrationChains();
    for (const LocationProfile& profile : topology.locations.getLocationProfiles()) {
        const std::string name = text(profile.getProfileName());
        std::string label =
            name + "\n" + locationTypeName(profile) + (profile.IsWAN() ? ", WAN" : "");
        for (const ACE_CString& server : profile.getLocalServers()) {
            label += "\n" + text(server);
        }
        out << "  " << quoted("location " + name) << " [shape=house, style=filled, "
            << "fillcolor=" << (profile.IsMainCalyra() ? "gold" : "wheat")
            << ", label=" << quoted(label) << "];\n";
        const auto chain = chains.find(profile.getProfileName());
        if (chain == chains.end()) {
            continue;
        }
        std::string from = "location " + name;
        int hop = 1;
        for (const Link& link : chain->second) {
            const Resolved r = resolve(topology, link);
            const std::string to = (r.kind == Resolved::Stack     ? "stack "
                                    : r.kind == Resolved::Unknown ? "unresolved "
                                                                  : "host ") +
                                   r.name;
            out << "  " << quoted(to) << (r.kind == Resolved::Unknown ? " [color=red]" : "")
                << ";\n  " << quoted(from) << " -> " << quoted(to)
                << " [label=" << quoted(name + " " + std::to_string(hop++)) << "];\n";
            from = to;
        }
    }
    for (const auto& server : topology.archive.getTivoliServers()) {
        out << "  " << quoted("tape " + text(server.first)) << " [shape=cylinder, style=filled, "
            << "fillcolor=lavender, label=" << quoted("tape server\n" + text(server.first))
            << "];\n";
    }
    for (const auto& stack : topology.archive.getArchiveStacks()) {
        out << "  " << quoted("stack " + text(stack.first)) << " -> "
            << quoted("tape " + text(stack.second.getTivoliServer()))
            << " [style=dotted, label=" << quoted(text(stack.second.getArchiveFilespaceName()))
            << "];\n";
    }
    out << "}\n";
}

void printArchive(const Configuration::KelArchiveConfiguration& archive, std::ostream& out) {
    for (const auto& entry : archive.getTivoliServers()) {
        const auto& server = entry.second;
        out << "Tape server " << text(server.getTivoliStorageManagerHostname()) << ":"
            << server.getTivoliStorageManagerPort() << "  user "
            << text(server.getTivoliServerUserAccount()) << "  password " << kMaskedPassword
            << "\n";
    }
    for (const auto& entry : archive.getArchiveNodes()) {
        out << "Node " << text(entry.first) << "\n";
        for (const auto& node : entry.second.getTivoliNodeInfos()) {
            out << "  server " << text(node.first) << "  threads " << node.second.getNumberThreads()
                << "  block " << node.second.getTivoliServerBlockTransferSize()
                << "  session time-out " << node.second.getTivoliSessionTimeout() << " s\n";
        }
    }
    for (const auto& entry : archive.getArchiveStacks()) {
        out << "Stack " << text(entry.first) << "  -> " << text(entry.second.getTivoliServer())
            << "  node " << text(entry.second.getLocalNodeName()) << "  file space "
            << text(entry.second.getArchiveFilespaceName()) << "\n";
    }
    out << "Archive at " << text(archive.getArchiveTimeOfDay()) << ", delay "
        << archive.getArchiveDelayTime() << ", deletion time-out " << archive.getDeletionTimeout()
        << " s" << (archive.getDisableArchiveRequests() ? ", requests disabled" : "") << "\n";
}

void maskCredentials(Vesk::Element& tree) {
    maskValue(tree);
}

}  // namespace Configctl
