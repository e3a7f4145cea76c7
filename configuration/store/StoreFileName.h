// StoreFileName: turns host and configuration names into file names that cannot leave the store
// directory, and back. Every byte outside [A-Za-z0-9._-] becomes "%XX" (upper-case hex), and a
// leading '.' becomes "%2E", so an encoded name never holds '/', '\', NUL or '~', never starts
// with a dot and is never "." or "..". An item's file is the encoded (lower-case) host, '~', and
// the encoded name; a key too long for one file name keeps a readable prefix and a hash instead
// (the item file itself records the exact host and name). Stateless; thread-safe.
#pragma once

#include <string>

namespace Configuration {

class StoreFileName {
public:
    // The longest file name this store creates (below NAME_MAX with room for a temporary suffix).
    static constexpr std::size_t kMaxLength = 200;

    // The percent-encoded form of text.
    static std::string encode(const std::string& text);
    // Reverses encode(); false when encoded is not a well-formed encoding.
    static bool decode(const std::string& encoded, std::string& text);
    // The file name of the item (host, name); host is expected in lower case already.
    static std::string item(const std::string& host, const std::string& name);
    // Whether a directory entry may be an item file (reserved and temporary names are not).
    static bool isItemFile(const std::string& fileName);
};

}  // namespace Configuration
