// Base64Cache: the Base64 text of large stored documents, encoded once and shared by every
// answer that carries the document while its bytes live. The store never changes an item's
// bytes (a new store makes new bytes), so a text is keyed by its bytes and dropped once they
// are gone. Holds at most a budget of text: texts of dropped items go at the next insertion,
// and when live ones alone would exceed it, all go. Thread-safe; answers copy a text while holding
// their own reference to it.
#pragma once

#include <cstddef>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_map>

namespace ConfigurationService {

class Base64Cache {
public:
    // Keeps up to budgetBytes of text in all.
    explicit Base64Cache(std::size_t budgetBytes);

    // The Base64 text of bytes: cached, or encoded now and kept.
    std::shared_ptr<const std::string> text(const std::shared_ptr<const std::string>& bytes);
    // Characters of text held now.
    std::size_t heldBytes() const;

private:
    struct Entry {
        std::weak_ptr<const std::string> bytes;
        std::shared_ptr<const std::string> text;
    };

    void keep(const std::shared_ptr<const std::string>& bytes,
              const std::shared_ptr<const std::string>& text);
    void dropGone();

    const std::size_t m_budget;
    mutable std::mutex m_mutex;  // guards m_entries and m_held
    std::unordered_map<const std::string*, Entry> m_entries;
    std::size_t m_held = 0;
};

}  // namespace ConfigurationService
