// Configuration::TransferSyntaxList: the resolved transfer syntaxes of one SOP service or template,
// in the order in which they were resolved. Built by the SOP service document while it reads;
// never read or written as an element of its own. Plain value owned by its caller; not
// thread-safe.
#pragma once

#include <vector>

#include "Configuration/Export.h"
#include "Configuration/TransferSyntax.h"

namespace Configuration {

class CONFIGURATION_API TransferSyntaxList {
public:
    // The entries, in resolved order.
    const std::vector<TransferSyntax>& getTransferSyntaxes() const { return m_entries; }
    // The entries, for the document that builds them.
    std::vector<TransferSyntax>& getTransferSyntaxes() { return m_entries; }

    // Equal when the entries are equal, in order.
    friend bool operator==(const TransferSyntaxList& a, const TransferSyntaxList& b) {
        return a.m_entries == b.m_entries;
    }
    friend bool operator!=(const TransferSyntaxList& a, const TransferSyntaxList& b) {
        return !(a == b);
    }

private:
    std::vector<TransferSyntax> m_entries;
};

}  // namespace Configuration
