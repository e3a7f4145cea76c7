// StoredDocuments: the answer to "RetrieveItems": one element tree "ConfigurationItems" whose
// children "ConfigurationItem" (attributes "Host", "ConfigurationName", "LastModifiedTime") each
// hold one requested document's tree, in request order, written in the element tree's XML form.
// Stateless; thread-safe.
#pragma once

#include <string>

#include "Store/DirectoryStore.h"

namespace ConfigurationService {

class StoredDocuments {
public:
    // The XML of the documents named in names (separated by separator; empty entries are
    // skipped) of host. Throws OperationFailed: 404 with the path-not-found key for a missing
    // document, 500 for one that is not a stored element tree, 400 when no name is given.
    static std::string collect(const Configuration::DirectoryStore& store, const std::string& host,
                               const std::string& names, char separator);
};

}  // namespace ConfigurationService
