#include "DicomSite.h"

#include "LogCollector.h"

namespace Configctl {
namespace {

std::string text(const ACE_CString& value) {
    return std::string(value.c_str(), value.length());
}

void addNode(std::vector<DicomNode>& nodes, const Configuration::ConfigDoc& document,
             const char* role, const Configuration::RemoteSCPConfiguration& node) {
    nodes.push_back(DicomNode{documentName(document), role, text(node.getRemoteHostDescription()),
                              text(node.getAETitle()), text(node.getHostName()),
                              text(node.getPort())});
}

}  // namespace

std::string documentName(const Configuration::ConfigDoc& document) {
    const std::string path = text(document.path());
    const std::string prefix = text(Configuration::ConfigDoc::getConfigurationRegistryPath());
    return path.compare(0, prefix.size(), prefix) == 0 ? path.substr(prefix.size()) : path;
}

void DicomSite::load(const Fetch& fetch) {
    Configuration::ConfigDoc* const all[] = {
        &storage,    &queryRetrieve, &commitment, &exportGlobal, &exportLocal, &destinations,
        &webService, &autoExport,    &query,      &sopServices,  &dicomClient,
    };
    documents.clear();
    LogCollector log;
    for (Configuration::ConfigDoc* document : all) {
        DocumentStatus status;
        status.path = text(document->path());
        Vesk::Element tree;
        std::string unreadable;
        try {
            status.stored = fetch(*document, tree);
        } catch (const std::exception& e) {
            status.stored = true;
            unreadable = std::string("cannot be read: ") + e.what();
        }
        if (status.stored && unreadable.empty()) {
            status.complete = document->readVesk(tree);
        }
        status.logged = log.take();
        if (!unreadable.empty()) {
            status.logged.push_back(unreadable);
        }
        documents.push_back(status);
    }
}

std::vector<DicomNode> DicomSite::nodes() const {
    std::vector<DicomNode> found;
    for (const Configuration::KelExportRemoteScp& destination : destinations.getRemoteScps()) {
        addNode(found, destinations, "export destination", destination);
        const auto& commit = destination.getStorageCommitScpConfiguration();
        if (!commit.getAETitle().empty() || !commit.getHostName().empty()) {
            addNode(found, destinations, "export commitment", commit);
        }
    }
    for (const Configuration::KelQueryRemoteSCPConfiguration& archive : query.getArchives()) {
        addNode(found, query, "query archive", archive);
    }
    for (const auto& requester : commitment.getRemoteConfigurations()) {
        addNode(found, commitment, "commitment requester", requester);
    }
    for (const Configuration::ServerDicomSource& source : storage.getDicomSources()) {
        found.push_back(DicomNode{documentName(storage), "known source",
                                  text(source.getSourceName()), text(source.getAETitle()), "", ""});
    }
    return found;
}

}  // namespace Configctl
