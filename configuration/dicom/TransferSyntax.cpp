#include "Configuration/TransferSyntax.h"

#include <utility>

namespace Configuration {

TransferSyntax::TransferSyntax() : m_row(std::make_shared<const SupportedTransferSyntax>()) {}

TransferSyntax::TransferSyntax(const SupportedTransferSyntax& row)
    : m_row(std::make_shared<const SupportedTransferSyntax>(row)) {}

TransferSyntax::TransferSyntax(std::shared_ptr<const SupportedTransferSyntax> row)
    : m_row(row ? std::move(row) : std::make_shared<const SupportedTransferSyntax>()) {}

bool operator==(const TransferSyntax& a, const TransferSyntax& b) {
    return a.m_enabled == b.m_enabled && (a.m_row == b.m_row || *a.m_row == *b.m_row);
}

}  // namespace Configuration
