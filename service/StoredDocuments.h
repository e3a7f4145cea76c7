// StoredDocuments: the answer to "RetrieveItems": one element tree "ConfigurationItems" whose
// children "ConfigurationItem" (attributes "Host", "ConfigurationName", "LastModifiedTime") each
// hold one requested document's tree, in request order, written in the element tree's XML form;
// nothing at all when none of the requested documents exists. Stateless; thread-safe.
#pragma once

#include <string>

#include "Store/DirectoryStore.h"

namespace ConfigurationService {

class StoredDocuments {
public:
    // The XML of the documents named in names (split at any of separators; empty entries are
    // skipped) of host; an empty text when none of them exists. Throws OperationFailed: 404
    // with the path-not-found key when some but not all exist, 500 for one that is not a stored
    // element tree, 400 when no name is given.
    static std::string collect(const Configuration::DirectoryStore& store, const std::string& host,
                               const std::string& names, const char* separators);
};

}  // namespace ConfigurationService
