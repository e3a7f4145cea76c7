// Base64 texts of large documents, kept while their bytes live.
#include "Base64Cache.h"

#include "Quorvex/Base64Coder.h"

namespace ConfigurationService {
namespace {

std::shared_ptr<const std::string> encode(const std::string& bytes) {
    auto text = std::make_shared<std::string>(Base64Coder::EncodedLength(bytes.size()), '\0');
    Base64Coder::EncodeInto(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size(),
                            &(*text)[0]);
    return text;
}

}  // namespace

Base64Cache::Base64Cache(std::size_t budgetBytes) : m_budget(budgetBytes) {}

std::shared_ptr<const std::string> Base64Cache::text(
    const std::shared_ptr<const std::string>& bytes) {
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        auto it = m_entries.find(bytes.get());
        // A live weak pointer to the same bytes: not a new string at a freed one's address.
        if (it != m_entries.end() && it->second.bytes.lock() == bytes) {
            return it->second.text;
        }
    }
    std::shared_ptr<const std::string> text = encode(*bytes);
    keep(bytes, text);
    return text;
}

std::size_t Base64Cache::heldBytes() const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_held;
}

void Base64Cache::keep(const std::shared_ptr<const std::string>& bytes,
                       const std::shared_ptr<const std::string>& text) {
    if (text->size() > m_budget) {
        return;
    }
    std::lock_guard<std::mutex> lock(m_mutex);
    dropGone();
    if (m_held + text->size() > m_budget) {
        m_entries.clear();
        m_held = 0;
    }
    Entry& entry = m_entries[bytes.get()];
    if (entry.text) {
        m_held -= entry.text->size();
    }
    entry = Entry{bytes, text};
    m_held += text->size();
}

// Called with m_mutex held.
void Base64Cache::dropGone() {
    for (auto it = m_entries.begin(); it != m_entries.end();) {
        if (it->second.bytes.expired()) {
            m_held -= it->second.text->size();
            it = m_entries.erase(it);
        } else {
            ++it;
        }
    }
}

}  // namespace ConfigurationService
