#include "Vesk/ShortString.h"

namespace Vesk {

ShortString& ShortString::operator=(const ShortString& other) {
    if (this != &other) {
        assign(other.m_string);
    }
    return *this;
}

ShortString& ShortString::operator=(ShortString&& other) noexcept {
    if (this != &other) {
        clear();
        take(other);
    }
    return *this;
}

void ShortString::assign(const char* text, std::size_t len) {
    if (len < kInline) {
        // memmove: text may be (part of) this very string. A view owns nothing, and set() frees
        // a previous heap buffer only after the bytes are in place.
        std::memmove(m_inline, text, len);
        m_inline[len] = '\0';
        m_string.set(m_inline, len, false);
        return;
    }
    // Copied before the old buffer goes, for the same reason.
    ACE_CString owned(text, len);
    m_string.swap(owned);
}

void ShortString::take(ShortString& other) noexcept {
    if (other.isInline()) {
        const std::size_t len = other.m_string.length();
        std::memcpy(m_inline, other.m_inline, len + 1);
        m_string.set(m_inline, len, false);
    } else {
        m_string.swap(other.m_string);
    }
    other.clear();
}

}  // namespace Vesk
