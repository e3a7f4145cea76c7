// Configuration::NoCaseCompare: orders strings by their bytes with ASCII letters folded to lower
// case, so "ae1" and "AE1" are one key. The ordering of sets of AE titles and the like.
// Stateless; thread-safe.
#pragma once

#include <ace/SString.h>

#include <cctype>
#include <cstddef>

namespace Configuration {

struct NoCaseCompare {
    // True when a sorts before b, ignoring case.
    bool operator()(const ACE_CString& a, const ACE_CString& b) const {
        const std::size_t n = a.length() < b.length() ? a.length() : b.length();
        for (std::size_t i = 0; i < n; ++i) {
            const int x = std::tolower(static_cast<unsigned char>(a[i]));
            const int y = std::tolower(static_cast<unsigned char>(b[i]));
            if (x != y) {
                return x < y;
            }
        }
        return a.length() < b.length();
    }
};

}  // namespace Configuration
