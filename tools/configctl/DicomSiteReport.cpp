#include "DicomSiteReport.h"

#include <algorithm>
#include <array>
#include <string>

#include "JsonText.h"

namespace Configctl {
namespace {

using Row = std::array<std::string, 6>;

void printTable(const std::vector<Row>& rows, std::ostream& out) {
    Row::size_type columns = rows.empty() ? 0 : rows[0].size();
    std::vector<std::size_t> widths(columns, 0);
    for (const Row& row : rows) {
        for (std::size_t i = 0; i < columns; ++i) {
            widths[i] = std::max(widths[i], row[i].size());
        }
    }
    for (const Row& row : rows) {
        std::string line;
        for (std::size_t i = 0; i < columns; ++i) {
            line += row[i];
            if (i + 1 < columns) {
                line += std::string(widths[i] - row[i].size() + 2, ' ');
            }
        }
        while (!line.empty() && line.back() == ' ') {
            line.pop_back();
        }
        out << line << "\n";
    }
}

std::string readState(const DocumentStatus& status) {
    if (!status.stored) {
        return "not stored (the defaults apply)";
    }
    return status.complete ? "read completely" : "INCOMPLETE";
}

}  // namespace

void printDicomNodes(const DicomSite& site, std::ostream& out) {
    std::vector<Row> rows = {{"DOCUMENT", "ROLE", "AE TITLE", "HOST", "PORT", "NAME"}};
    for (const DicomNode& node : site.nodes()) {
        rows.push_back({node.document, node.role, node.aeTitle, node.host.empty() ? "-" : node.host,
                        node.port.empty() ? "-" : node.port, node.name});
    }
    printTable(rows, out);
}

void printSiteCheck(const DicomSite& site, const std::vector<SiteProblem>& problems,
                    std::ostream& out) {
    out << "Documents:\n";
    for (const DocumentStatus& status : site.documents) {
        out << "  " << status.path << ": " << readState(status) << "\n";
        for (const std::string& line : status.logged) {
            out << "      logged: " << line << "\n";
        }
    }
    out << "\nSite checks:\n";
    for (const SiteProblem& problem : problems) {
        out << "  " << problem.document << ": " << problem.text << "\n";
    }
    if (problems.empty()) {
        out << "  no mistakes found\n";
    }
    out << "\n"
        << problems.size() << (problems.size() == 1 ? " mistake" : " mistakes") << " found\n";
}

void printDicomNodesJson(const DicomSite& site, std::ostream& out) {
    JsonWriter json(out);
    json.beginArray();
    for (const DicomNode& node : site.nodes()) {
        json.beginObject().field("document", node.document).field("role", node.role);
        json.field("aeTitle", node.aeTitle).key("host").optional(node.host);
        json.key("port").optional(node.port).field("name", node.name).endObject();
    }
    json.endArray();
}

void printSiteCheckJson(const DicomSite& site, const std::vector<SiteProblem>& problems,
                        std::ostream& out) {
    JsonWriter json(out);
    json.beginObject().key("documents").beginArray();
    for (const DocumentStatus& status : site.documents) {
        json.beginObject().field("path", status.path).field("stored", status.stored);
        json.field("complete", status.complete).key("logged").beginArray();
        for (const std::string& line : status.logged) {
            json.value(line);
        }
        json.endArray().endObject();
    }
    json.endArray().key("problems").beginArray();
    for (const SiteProblem& problem : problems) {
        json.beginObject().field("document", problem.document).field("text", problem.text);
        json.endObject();
    }
    json.endArray().endObject();
}

}  // namespace Configctl
