// DicomSite: every DICOM document of one host read through its class, with how each read went,
// and the remote DICOM nodes the documents name. Plain value; not thread-safe.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "Configuration/AutoExportConfiguration.h"
#include "Configuration/DicomClientConfiguration.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/KelQueryConfiguration.h"
#include "Configuration/QrscpConfiguration.h"
#include "Configuration/SOPServiceConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "Configuration/StorageCommitConfiguration.h"
#include "Vesk/Element.h"

namespace Configctl {

// How one document read.
struct DocumentStatus {
    std::string path;
    bool stored = false;              // false: not stored, its class keeps its defaults
    bool complete = false;            // every required key present, no item dropped
    std::vector<std::string> logged;  // what the read logged
};

// One remote node as a document names it.
struct DicomNode {
    std::string document;  // the document's name
    std::string role;      // "export destination", "query archive", ...
    std::string name;      // its description or source name
    std::string aeTitle;
    std::string host;  // empty for a known source (no address is configured)
    std::string port;
};

struct DicomSite {
    // Gives a stored document's tree; false when the document is not stored. Throws on other
    // failures.
    using Fetch = std::function<bool(const Configuration::ConfigDoc&, Vesk::Element&)>;

    // Reads every DICOM document through fetch into its class.
    void load(const Fetch& fetch);
    // Every remote node the documents name, document by document.
    std::vector<DicomNode> nodes() const;

    std::vector<DocumentStatus> documents;
    Configuration::SSCPConfiguration storage;
    Configuration::QrscpConfiguration queryRetrieve;
    Configuration::StorageCommitConfiguration commitment;
    Configuration::KelExportGlobalConfiguration exportGlobal;
    Configuration::KelExportLocalConfiguration exportLocal;
    Configuration::KelExportRemoteConfigurations destinations;
    Configuration::KelExportWebService webService;
    Configuration::AutoExportConfiguration autoExport;
    Configuration::KelQueryConfiguration query;
    Configuration::SOPServiceConfiguration sopServices;
    Configuration::DicomClientConfiguration dicomClient;
};

// The name of a document: its path without the registry prefix.
std::string documentName(const Configuration::ConfigDoc& document);

}  // namespace Configctl
