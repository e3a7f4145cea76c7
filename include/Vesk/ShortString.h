// Vesk::ShortString: an ACE_CString that keeps a string of fewer than kInline bytes in its own
// storage instead of on the heap. The element tree holds its keys and texts in it: most are short,
// so building a tree allocates nothing for them. str() is an ordinary ACE_CString (a view of the
// inner storage when the string is short); a copy made from it is an ordinary heap string. Each
// ShortString owns what it holds. Plain data: not thread-safe for concurrent mutation.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <cstring>

namespace Vesk {

class ShortString {
public:
    static constexpr std::size_t kInline = 32;  // room for 31 bytes and the terminating NUL

    ShortString() = default;
    ShortString(const char* text, std::size_t len) { assign(text, len); }
    explicit ShortString(const ACE_CString& text) { assign(text); }
    ShortString(const ShortString& other) { assign(other.m_string); }
    // The moved-from string is left empty.
    ShortString(ShortString&& other) noexcept { take(other); }
    ShortString& operator=(const ShortString& other);
    ShortString& operator=(ShortString&& other) noexcept;
    ~ShortString() = default;

    // The string, valid until this ShortString changes or goes away.
    const ACE_CString& str() const { return m_string; }
    // Replaces the string by the len bytes at text, which may lie inside this string.
    void assign(const char* text, std::size_t len);
    void assign(const ACE_CString& text) { assign(text.c_str(), text.length()); }
    void assign(const char* text) { assign(text, std::strlen(text)); }
    // Empties the string.
    void clear() noexcept { m_string.clear(true); }

private:
    bool isInline() const { return m_string.c_str() == m_inline; }
    // Moves other's string here (leaving other empty); this string must be empty.
    void take(ShortString& other) noexcept;

    ACE_CString m_string;  // a view of m_inline when short, else an owned heap string
    char m_inline[kInline];
};

}  // namespace Vesk
