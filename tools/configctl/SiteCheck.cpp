#include "SiteCheck.h"

#include <strings.h>

#include <cstdio>
#include <map>

namespace Configctl {
namespace {

constexpr std::size_t kMaxAETitle = 16;

std::string text(const ACE_CString& value) {
    return std::string(value.c_str(), value.length());
}

std::string quoted(const std::string& value) {
    return "\"" + value + "\"";
}

bool sameName(const std::string& a, const std::string& b) {
    return a.size() == b.size() && ::strncasecmp(a.c_str(), b.c_str(), a.size()) == 0;
}

class Checker {
public:
    explicit Checker(const DicomSite& site) : m_site(site) {}

    std::vector<SiteProblem> run() {
        documents();
        localTitles();
        nodes();
        autoExportDestinations();
        longTermStorage();
        return m_problems;
    }

private:
    void add(const std::string& document, const std::string& problem) {
        m_problems.push_back(SiteProblem{document, problem});
    }
    void title(const std::string& document, const std::string& who, const std::string& value) {
        const std::string fault = aeTitleFault(value);
        if (!fault.empty()) {
            add(document, who + ": AE title " + quoted(value) + " " + fault);
        }
    }
    void localPort(const std::string& document, const std::string& who, long long port) {
        if (port < 1 || port > 65535) {
            add(document, who + ": port " + std::to_string(port) + " is outside 1-65535");
        }
    }

    void documents() {
        for (const DocumentStatus& status : m_site.documents) {
            if (status.stored && !status.complete) {
                const std::string prefix =
                    text(Configuration::ConfigDoc::getConfigurationRegistryPath());
                add(status.path.compare(0, prefix.size(), prefix) == 0
                        ? status.path.substr(prefix.size())
                        : status.path,
                    "does not read completely (a required key is missing or an entry was left "
                    "out); what is missing keeps its default");
            }
        }
    }

    void localTitles() {
        const std::string scp = documentName(m_site.storage);
        title(scp, "storage provider (NormalAETitle)", text(m_site.storage.getNormalAETitle()));
        title(scp, "storage provider (HighPriorityAETitle)",
              text(m_site.storage.getHiPriorityAETitle()));
        localPort(scp, "storage provider", m_site.storage.getPort());
        for (const ACE_CString& filtered : m_site.storage.getSuidGenerationAETitleFilter()) {
            title(scp, "study UID filter", text(filtered));
        }
        const std::string qr = documentName(m_site.queryRetrieve);
        title(qr, "query/retrieve provider", text(m_site.queryRetrieve.getQrscpAeTitle()));
        localPort(qr, "query/retrieve provider", m_site.queryRetrieve.getPort());
        for (const ACE_CString& allowed : m_site.queryRetrieve.getAllowedAeTitles()) {
            title(qr, "allowed AE titles", text(allowed));
        }
        title(documentName(m_site.exportLocal), "export server",
              text(m_site.exportLocal.getKelExportAETitle()));
        title(documentName(m_site.query), "query module", text(m_site.query.getKelQueryAETitle()));
    }

    void nodes() {
        struct Seen {
            std::string host;
            std::string port;
            std::string who;
        };
        std::map<std::string, Seen> byTitle;
        for (const DicomNode& node : m_site.nodes()) {
            const std::string who = node.role + " " + quoted(node.name);
            title(node.document, who, node.aeTitle);
            if (node.role == "known source") {
                continue;  // no address
            }
            const std::string fault = portFault(node.port);
            if (!fault.empty()) {
                add(node.document, who + ": port " + quoted(node.port) + " " + fault);
            }
            const auto [seen, first] =
                byTitle.emplace(node.aeTitle, Seen{node.host, node.port, who});
            if (!first &&
                (!sameName(seen->second.host, node.host) || seen->second.port != node.port)) {
                add(node.document, who + ": AE title " + quoted(node.aeTitle) + " is at " +
                                       node.host + ":" + node.port + ", but " + seen->second.who +
                                       " has it at " + seen->second.host + ":" + seen->second.port);
            }
        }
    }

    bool isDestination(const std::string& name) const {
        for (const auto& destination : m_site.destinations.getRemoteScps()) {
            if (sameName(name, text(destination.getRemoteHostDescription())) ||
                sameName(name, text(destination.getAETitle()))) {
                return true;
            }
        }
        return false;
    }

    void autoExportDestinations() {
        for (const Configuration::AutoExportRule& rule : m_site.autoExport.getRules()) {
            for (const Configuration::Destination& destination : rule.getDestinations()) {
                const std::string name = text(destination.getDestinationName());
                if (!isDestination(name)) {
                    add(documentName(m_site.autoExport),
                        "rule " + quoted(text(rule.getName())) + " sends to " + quoted(name) +
                            ", which no export destination in " +
                            documentName(m_site.destinations) + " defines");
                }
            }
        }
    }

    void longTermStorage() {
        const std::string destination = text(m_site.destinations.getLongTermStorageDestination());
        if (!destination.empty() && !isDestination(destination)) {
            add(documentName(m_site.destinations), "the long-term storage destination " +
                                                       quoted(destination) +
                                                       " is not one of its export destinations");
        }
        const std::string archive = text(m_site.query.getLongTermStorageArchive());
        if (archive.empty()) {
            return;
        }
        for (const auto& known : m_site.query.getArchives()) {
            if (sameName(archive, text(known.getRemoteHostDescription())) ||
                sameName(archive, text(known.getAETitle()))) {
                return;
            }
        }
        add(documentName(m_site.query),
            "the long-term storage archive " + quoted(archive) + " is not one of its archives");
    }

    const DicomSite& m_site;
    std::vector<SiteProblem> m_problems;
};

}  // namespace

std::string aeTitleFault(const std::string& title) {
    if (title.find_first_not_of(' ') == std::string::npos) {
        return "is empty";
    }
    if (title.size() > kMaxAETitle) {
        return "is " + std::to_string(title.size()) + " characters long (at most 16)";
    }
    for (const char c : title) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte < 0x20 || byte > 0x7e || c == '\\') {
            char shown[8];
            std::snprintf(shown, sizeof shown, "0x%02X", byte);
            return std::string("holds the character ") + shown +
                   ", which DICOM does not allow in an AE title";
        }
    }
    return "";
}

std::string portFault(const std::string& text) {
    if (text.empty() || text.size() > 5 ||
        text.find_first_not_of("0123456789") != std::string::npos) {
        return "is not a port number (1-65535)";
    }
    const long port = std::stol(text);
    return port >= 1 && port <= 65535 ? "" : "is outside 1-65535";
}

std::vector<SiteProblem> checkSite(const DicomSite& site) {
    return Checker(site).run();
}

}  // namespace Configctl
