// SOPServiceIndex: the look-up tables a SOP service document resolves its lists with, built once
// per resolution pass so that a document of many services and rows resolves in time linear in
// its size: the master table by number (a later row with the same number wins), and the
// templates by name and additional flag (the first one wins). Each row is copied once into an
// immutable shared row that every entry built from it refers to. Owned by the document while it
// reads; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "Configuration/SupportedTransferSyntax.h"
#include "Configuration/TemplateTransferSyntaxList.h"
#include "Configuration/TransferSyntaxList.h"

namespace Configuration {

class SOPServiceIndex {
public:
    // Indexes the master table's rows, in order.
    explicit SOPServiceIndex(const std::vector<SupportedTransferSyntax>& rows);

    // Appends to list the rows that text names, each at most once, in the order of text; unknown
    // numbers are ignored.
    void appendNamed(const ACE_CString& text, TransferSyntaxList& list);
    // Indexes the templates (whose addresses must stay put while the index is used).
    void indexTemplates(std::vector<TemplateTransferSyntaxList>& templates);
    // The first indexed template with that name and additional flag; null if none.
    TemplateTransferSyntaxList* findTemplate(const ACE_CString& name, bool additional) const;

private:
    std::unordered_map<int, std::size_t> m_slotOfNumber;
    std::vector<std::shared_ptr<const SupportedTransferSyntax>> m_rowOfSlot;
    // m_usedIn[slot] == m_call: the slot was taken by the current appendNamed already.
    std::vector<unsigned> m_usedIn;
    unsigned m_call = 0;
    // Keyed by views of the templates' own names.
    std::unordered_map<std::string_view, TemplateTransferSyntaxList*> m_templates[2];
};

// Enables exactly the entries of list that text names (the later of two entries with the same
// number); an empty text leaves every entry disabled.
void enableNamed(TransferSyntaxList& list, const ACE_CString& text);

}  // namespace Configuration
