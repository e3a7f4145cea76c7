// Configuration::TransferSyntax: a transfer syntax as one SOP service (or template) offers it: a
// row of the master table and whether the service accepts it. Built by the SOP service document
// when it resolves its lists; never read or written as an element of its own.
//
// The row is an immutable copy shared between the entries built from it (a document of many
// services holds one copy of each row); copying a TransferSyntax is cheap and the copies are
// independent values. Owned by its caller; not thread-safe, but copies in different threads may
// share rows.
#pragma once

#include <ace/SString.h>

#include <memory>

#include "Configuration/Export.h"
#include "Configuration/SupportedTransferSyntax.h"

namespace Configuration {

class CONFIGURATION_API TransferSyntax {
public:
    // An enabled entry of an empty row.
    TransferSyntax();
    // An enabled entry holding a copy of row.
    explicit TransferSyntax(const SupportedTransferSyntax& row);
    // An enabled entry sharing an immutable row.
    explicit TransferSyntax(std::shared_ptr<const SupportedTransferSyntax> row);

    // Whether the service accepts this syntax.
    bool getEnabled() const { return m_enabled; }
    void setEnabled(bool enabled) { m_enabled = enabled; }
    // The row of the master table this entry was built from.
    const SupportedTransferSyntax& getSupportedTransferSyntax() const { return *m_row; }
    // The row's number.
    int getNr() const { return m_row->getNr(); }
    // The row's transfer syntax UID.
    const ACE_CString& getUID() const { return m_row->getUID(); }
    // The row's display name.
    const ACE_CString& getName() const { return m_row->getName(); }
    // The row's description.
    const ACE_CString& getDescription() const { return m_row->getDescription(); }

    // The shared row (for building further entries from it without copying it).
    const std::shared_ptr<const SupportedTransferSyntax>& sharedRow() const { return m_row; }

    // Equal when both enabled states and both rows are equal.
    friend CONFIGURATION_API bool operator==(const TransferSyntax& a, const TransferSyntax& b);
    friend bool operator!=(const TransferSyntax& a, const TransferSyntax& b) { return !(a == b); }

private:
    bool m_enabled = true;
    std::shared_ptr<const SupportedTransferSyntax> m_row;
};

}  // namespace Configuration
