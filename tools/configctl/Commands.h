// Commands: configctl's commands over the library's HttpConfigurationClient. Documents are
// printed inflated and indented; put parses the XML file first, so only well-formed element
// trees are stored. Owns its client; writes results to the given stream. Not thread-safe.
#pragma once

#include <ace/SString.h>

#include <memory>
#include <ostream>

#include "ToolOptions.h"

namespace Configuration {
class HttpConfigurationClient;
class ProcessesAndServicesConfiguration;
}  // namespace Configuration

namespace Configctl {

struct DicomSite;
class JsonWriter;

class Commands {
public:
    Commands(const ToolOptions& options, std::ostream& out);
    ~Commands();
    Commands(const Commands&) = delete;
    Commands& operator=(const Commands&) = delete;

    // Runs the command; throws std::exception (one-line what()) on failure.
    void run();

private:
    Configuration::HttpConfigurationClient& client();
    ACE_CString host();
    // Where remarks on incomplete documents go: stderr when stdout carries JSON or a graph.
    std::ostream& notes();
    void expectArguments(std::size_t min, std::size_t max, const char* form) const;

    void hosts();
    void items();
    void get();
    void put();
    void exists();
    void time();
    void registerService();
    void unregisterService();
    void info();
    void whoami();
    void dicomNodes();
    void check();
    void loadDicomSite(DicomSite& site);
    void sopServices();
    void topology();
    void archive();
    void users();
    void folders();
    void printFolder(const ACE_CString& folderId, int depth);
    void writeFolderJson(const ACE_CString& folderId, int depth, JsonWriter& json);
    void processes();
    void services();
    void loadProcesses(Configuration::ProcessesAndServicesConfiguration& config);

    const ToolOptions& m_options;
    std::ostream& m_out;
    std::unique_ptr<Configuration::HttpConfigurationClient> m_client;
};

}  // namespace Configctl
