// SiteCheck: the mistakes an administrator makes in a site's DICOM documents, found in a loaded
// DicomSite: documents that do not read completely, AE titles DICOM refuses (empty, over 16
// characters, control characters or a backslash), ports outside 1-65535, one AE title at two
// addresses, automatic-export destinations and long-term storage destinations or archives that
// no document defines. Export destinations and query archives are named by their description or
// their AE title (case ignored). Stateless; thread-safe.
#pragma once

#include <stdexcept>
#include <string>
#include <vector>

#include "DicomSite.h"

namespace Configctl {

// One mistake: the document it is in and what is wrong, in words a person can act on.
struct SiteProblem {
    std::string document;
    std::string text;
};

// What configctl check throws when it found mistakes (the tool then exits with status 2).
class CheckFailed : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// Every mistake in site, document by document.
std::vector<SiteProblem> checkSite(const DicomSite& site);

// Why title is not a valid AE title; empty when it is.
std::string aeTitleFault(const std::string& title);
// Why text is not a port (1-65535); empty when it is.
std::string portFault(const std::string& text);

}  // namespace Configctl
