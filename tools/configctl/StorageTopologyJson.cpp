// The storage topology and the tape archive as JSON, the same facts as the text reports.
#include "JsonText.h"
#include "StorageTopologyReport.h"

namespace Configctl {
namespace {

using Configuration::LocationProfile;

void writeLocations(const StorageTopology& topology, JsonWriter& json) {
    const auto& chains = topology.queues.getLocationMigrationChains();
    json.key("locations").beginArray();
    for (const LocationProfile& profile : topology.locations.getLocationProfiles()) {
        json.beginObject().field("name", profile.getProfileName());
        json.field("type", locationTypeName(profile)).field("wan", profile.IsWAN());
        json.key("servers").beginArray();
        for (const ACE_CString& server : profile.getLocalServers()) {
            json.value(server);
        }
        json.endArray();
        const auto chain = chains.find(profile.getProfileName());
        if (chain == chains.end()) {
            json.key("chain").null().key("resolved").null();
        } else {
            json.field("chain", Configuration::ChainUtils::chainToString(chain->second));
            json.field("resolved", resolvedChain(topology, chain->second));
        }
        json.endObject();
    }
    json.endArray();
}

void writeStacks(const StorageTopology& topology, JsonWriter& json) {
    json.key("stacks").beginArray();
    for (const auto& stack : topology.strategy.getAvailableStacks()) {
        ACE_CString mirror;
        topology.queues.getMirrorStackForPersistentStack(stack.getStackUid(), mirror);
        json.beginObject().field("uid", stack.getStackUid()).field("state", stackState(stack));
        json.key("mirror").optional(mirror.c_str()).endObject();
    }
    json.endArray();
}

// Queue names paired with their mirrors' queue names.
template <class Pairs>
void writeTargets(const char* name, const Pairs& targets, JsonWriter& json) {
    json.key(name).beginArray();
    for (const auto& target : targets) {
        json.beginObject().field("queue", target.first).field("mirror", target.second);
        json.endObject();
    }
    json.endArray();
}

}  // namespace

void printTopologyJson(const StorageTopology& topology, std::ostream& out) {
    JsonWriter json(out);
    json.beginObject();
    writeLocations(topology, json);
    writeStacks(topology, json);
    writeTargets("persistentTargets", topology.queues.getPersistentTargets(), json);
    writeTargets("retiredTargets", topology.queues.getRetiredPersistentTargets(), json);
    json.key("cacheTargets").beginArray();
    for (const ACE_CString& cache : topology.queues.getCacheMigrationTargets()) {
        json.value(cache);
    }
    json.endArray().key("tapeServers").beginArray();
    for (const auto& server : topology.archive.getTivoliServers()) {
        json.beginObject().field("name", server.first);
        json.field("port", server.second.getTivoliStorageManagerPort()).endObject();
    }
    json.endArray().endObject();
}

void printArchiveJson(const Configuration::KelArchiveConfiguration& archive, std::ostream& out) {
    JsonWriter json(out);
    json.beginObject().key("tapeServers").beginArray();
    for (const auto& entry : archive.getTivoliServers()) {
        const auto& server = entry.second;
        json.beginObject().field("host", server.getTivoliStorageManagerHostname());
        json.field("port", server.getTivoliStorageManagerPort());
        json.field("user", server.getTivoliServerUserAccount());
        json.field("password", kMaskedPassword).endObject();
    }
    json.endArray().key("nodes").beginArray();
    for (const auto& entry : archive.getArchiveNodes()) {
        json.beginObject().field("name", entry.first).key("servers").beginArray();
        for (const auto& node : entry.second.getTivoliNodeInfos()) {
            json.beginObject().field("server", node.first);
            json.field("threads", node.second.getNumberThreads());
            json.field("blockTransferSize", node.second.getTivoliServerBlockTransferSize());
            json.field("sessionTimeout", node.second.getTivoliSessionTimeout()).endObject();
        }
        json.endArray().endObject();
    }
    json.endArray().key("stacks").beginArray();
    for (const auto& entry : archive.getArchiveStacks()) {
        json.beginObject().field("stack", entry.first);
        json.field("server", entry.second.getTivoliServer());
        json.field("node", entry.second.getLocalNodeName());
        json.field("fileSpace", entry.second.getArchiveFilespaceName()).endObject();
    }
    json.endArray().field("archiveTimeOfDay", archive.getArchiveTimeOfDay());
    json.field("delay", archive.getArchiveDelayTime());
    json.field("deletionTimeout", archive.getDeletionTimeout());
    json.field("requestsDisabled", archive.getDisableArchiveRequests()).endObject();
}

}  // namespace Configctl
