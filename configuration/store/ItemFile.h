// ItemFile: the on-disk form of one stored item. A short text header (magic line, last-modified
// time in milliseconds since 1970 UTC, encoded host, encoded name, byte count, one per line)
// followed by the item's bytes exactly as stored. The header carries the exact host and name, so
// the file name is only where the item lives. Stateless; thread-safe.
#pragma once

#include <cstdint>
#include <string>

namespace Configuration {

class ItemFile {
public:
    // What a parsed item file holds; the data are content[dataOffset, dataOffset + dataSize).
    struct Parsed {
        std::string host;
        std::string name;
        std::int64_t lastModifiedMs = 0;
        std::size_t dataOffset = 0;
        std::size_t dataSize = 0;
    };

    // The header to write in front of dataSize bytes.
    static std::string header(const std::string& host, const std::string& name,
                              std::int64_t lastModifiedMs, std::size_t dataSize);
    // Parses a whole file; false when it is not a complete item file.
    static bool parse(const std::string& content, Parsed& parsed);
};

}  // namespace Configuration
