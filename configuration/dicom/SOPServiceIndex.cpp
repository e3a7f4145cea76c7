#include "SOPServiceIndex.h"

#include <algorithm>

#include "NumberList.h"

namespace Configuration {
namespace {

// Below this many entries a list is searched from its end instead of hashed.
constexpr std::size_t kLinearSearchLimit = 32;

std::string_view viewOf(const ACE_CString& text) {
    return std::string_view(text.c_str(), text.length());
}

// Enables the last entry numbered nr, if any, by a search from the end.
void enableLast(std::vector<TransferSyntax>& entries, int nr) {
    for (auto entry = entries.rbegin(); entry != entries.rend(); ++entry) {
        if (entry->getNr() == nr) {
            entry->setEnabled(true);
            return;
        }
    }
}

}  // namespace

SOPServiceIndex::SOPServiceIndex(const std::vector<SupportedTransferSyntax>& rows) {
    m_rowOfSlot.reserve(rows.size());
    for (const SupportedTransferSyntax& row : rows) {
        const auto inserted = m_slotOfNumber.emplace(row.getNr(), m_rowOfSlot.size());
        if (inserted.second) {
            m_rowOfSlot.push_back(std::make_shared<const SupportedTransferSyntax>(row));
        } else {
            m_rowOfSlot[inserted.first->second] =
                std::make_shared<const SupportedTransferSyntax>(row);
        }
    }
    m_usedIn.assign(m_rowOfSlot.size(), 0);
}

void SOPServiceIndex::appendNamed(const ACE_CString& text, TransferSyntaxList& list) {
    if (text.length() == 0) {
        return;
    }
    if (++m_call == 0) {  // wrapped: forget every earlier call
        std::fill(m_usedIn.begin(), m_usedIn.end(), 0);
        m_call = 1;
    }
    std::vector<TransferSyntax>& entries = list.getTransferSyntaxes();
    NumberList::scan(text.c_str(), text.length(), [&](int nr) {
        const auto found = m_slotOfNumber.find(nr);
        if (found == m_slotOfNumber.end() || m_usedIn[found->second] == m_call) {
            return;
        }
        m_usedIn[found->second] = m_call;
        entries.emplace_back(m_rowOfSlot[found->second]);
    });
}

void SOPServiceIndex::indexTemplates(std::vector<TemplateTransferSyntaxList>& templates) {
    for (auto& byName : m_templates) {
        byName.clear();
    }
    for (TemplateTransferSyntaxList& entry : templates) {
        m_templates[entry.getAdditional() ? 1 : 0].emplace(viewOf(entry.getName()), &entry);
    }
}

TemplateTransferSyntaxList* SOPServiceIndex::findTemplate(const ACE_CString& name,
                                                          bool additional) const {
    const auto& byName = m_templates[additional ? 1 : 0];
    const auto found = byName.find(viewOf(name));
    return found == byName.end() ? nullptr : found->second;
}

void enableNamed(TransferSyntaxList& list, const ACE_CString& text) {
    std::vector<TransferSyntax>& entries = list.getTransferSyntaxes();
    for (TransferSyntax& entry : entries) {
        entry.setEnabled(false);
    }
    if (text.length() == 0) {
        return;
    }
    if (entries.size() <= kLinearSearchLimit) {
        NumberList::scan(text.c_str(), text.length(), [&](int nr) { enableLast(entries, nr); });
        return;
    }
    std::unordered_map<int, TransferSyntax*> byNumber;
    for (TransferSyntax& entry : entries) {
        byNumber[entry.getNr()] = &entry;
    }
    NumberList::scan(text.c_str(), text.length(), [&](int nr) {
        const auto found = byNumber.find(nr);
        if (found != byNumber.end()) {
            found->second->setEnabled(true);
        }
    });
}

}  // namespace Configuration
