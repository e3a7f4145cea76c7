// Configuration::StringHash: hashes an ACE string by its bytes (case-sensitive), for hash maps
// keyed by UIDs and the like. Stateless; thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <functional>
#include <string_view>

namespace Configuration {

struct StringHash {
    // The hash of the string's bytes.
    std::size_t operator()(const ACE_CString& text) const {
        return std::hash<std::string_view>()(std::string_view(text.c_str(), text.length()));
    }
};

}  // namespace Configuration
