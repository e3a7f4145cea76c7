#include "CachedDocument.h"

#include "model/DocumentCodec.h"

namespace Configuration {

CachedDocument::CachedDocument(std::shared_ptr<const Vesk::Element> tree, const ConfigDoc& document)
    : m_tree(std::move(tree)) {
    m_typed.emplace(typeid(document), std::shared_ptr<const ConfigDoc>(document.clone()));
}

const ConfigDoc* CachedDocument::copyOf(const ConfigDoc& like) const {
    const auto found = m_typed.find(typeid(like));
    return found == m_typed.end() ? nullptr : found->second.get();
}

std::shared_ptr<const CachedDocument> CachedDocument::withCopyOf(const ConfigDoc& like) const {
    std::unique_ptr<ConfigDoc> copy(like.clone());
    DocumentCodec::readTree(*m_tree, *copy);
    copy->timestamp(timestamp());
    auto entry = std::make_shared<CachedDocument>(*this);
    entry->m_typed[typeid(like)] = std::shared_ptr<const ConfigDoc>(copy.release());
    return entry;
}

}  // namespace Configuration
