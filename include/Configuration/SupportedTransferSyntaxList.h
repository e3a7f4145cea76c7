// Configuration::SupportedTransferSyntaxList: the master table of transfer syntaxes of the SOP
// service document. Element "SupportedTxList" with one child "SupportedTx" per row, in document
// order; every row is kept, also one whose read was incomplete (the list then reads false).
// Reading appends to what the list holds. Read-only: writeVesk throws std::exception
// ("SupportedTransferSyntaxList::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/SupportedTransferSyntax.h"

namespace Configuration {

class CONFIGURATION_API SupportedTransferSyntaxList : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(SupportedTransferSyntaxList);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "SupportedTxList";

    // The rows, in document order.
    const std::vector<SupportedTransferSyntax>& getSupportedTransferSyntaxes() const {
        return m_rows;
    }

private:
    std::vector<SupportedTransferSyntax> m_rows;
};

}  // namespace Configuration
