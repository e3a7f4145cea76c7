// DicomSiteReport: what configctl prints about a site's DICOM documents: the table of remote
// nodes, and the check's report (per document how it read and what it logged, then every
// mistake found), as text or JSON. Stateless; thread-safe.
#pragma once

#include <ostream>
#include <vector>

#include "DicomSite.h"
#include "SiteCheck.h"

namespace Configctl {

// One line per remote node: document, role, AE title, host, port, name; aligned columns.
void printDicomNodes(const DicomSite& site, std::ostream& out);
// The check's report; the last line says how many mistakes were found.
void printSiteCheck(const DicomSite& site, const std::vector<SiteProblem>& problems,
                    std::ostream& out);
// The nodes as a JSON array of objects (document, role, aeTitle, host, port, name; host and port
// null when not configured).
void printDicomNodesJson(const DicomSite& site, std::ostream& out);
// The check as a JSON object: documents (path, stored, complete, logged) and problems.
void printSiteCheckJson(const DicomSite& site, const std::vector<SiteProblem>& problems,
                        std::ostream& out);

}  // namespace Configctl
