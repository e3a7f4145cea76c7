// CachedDocument: what the repository's cache keeps of one stored document: the element tree it
// was read from (or stored as), the stored timestamp, and one typed copy per class that has asked
// for it. Several classes may name the same document; each is served a copy of its own class,
// read once from the kept tree. Entries are immutable once shared: the cache replaces a whole
// entry instead of changing one, so a reader holding an entry outside the cache lock is safe.
#pragma once

#include <map>
#include <memory>
#include <typeindex>

#include "Configuration/ConfigDoc.h"
#include "Vesk/Element.h"

namespace Configuration {

class CachedDocument {
public:
    // An entry holding tree and the typed copy document (whose timestamp is the stored one).
    CachedDocument(std::shared_ptr<const Vesk::Element> tree, const ConfigDoc& document);

    // The stored timestamp.
    const BDateTime& timestamp() const { return m_typed.begin()->second->timestamp(); }
    // A typed copy of the entry (for the cache's facts: flags, version, lock, time).
    const ConfigDoc& any() const { return *m_typed.begin()->second; }
    // The copy of like's class, or null when this entry has none yet.
    const ConfigDoc* copyOf(const ConfigDoc& like) const;
    // An entry like this one that also holds a copy of like's class, read from the tree into a
    // copy of like; throws std::runtime_error when the tree does not read completely.
    std::shared_ptr<const CachedDocument> withCopyOf(const ConfigDoc& like) const;

private:
    std::shared_ptr<const Vesk::Element> m_tree;
    std::map<std::type_index, std::shared_ptr<const ConfigDoc>> m_typed;
};

}  // namespace Configuration
