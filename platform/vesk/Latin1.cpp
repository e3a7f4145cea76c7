#include "Latin1.h"

#include <cstdint>
#include <cstdio>
#include <cstring>

#include "Vesk/TrelException.h"

namespace Vesk {

namespace {

bool isAscii(const char* s, std::size_t len) {
    std::size_t i = 0;
    std::uint64_t bits = 0;
    for (; i + 8 <= len; i += 8) {
        std::uint64_t word;
        std::memcpy(&word, s + i, 8);
        bits |= word;
    }
    for (; i < len; ++i) {
        bits |= static_cast<unsigned char>(s[i]);
    }
    return (bits & 0x8080808080808080ull) == 0;
}

[[noreturn]] void refuse(unsigned char lead) {
    char message[160];
    std::snprintf(message, sizeof message,
                  "Vesk::XmlUtils: a character above U+00FF or broken UTF-8 (byte 0x%02X): the "
                  "tree holds 8-bit ISO-8859-1 strings only",
                  lead);
    throw TrelException(message);
}

void decode(const unsigned char* s, std::size_t len, std::string& out) {
    out.clear();
    out.reserve(len);
    for (std::size_t i = 0; i < len; ++i) {
        const unsigned char c = s[i];
        if (c < 0x80) {
            out.push_back(static_cast<char>(c));
        } else if ((c == 0xC2 || c == 0xC3) && i + 1 < len && (s[i + 1] & 0xC0) == 0x80) {
            out.push_back(static_cast<char>(((c & 0x03) << 6) | (s[i + 1] & 0x3F)));
            ++i;
        } else {
            refuse(c);
        }
    }
}

}  // namespace

std::string_view Latin1::view(const char* utf8, std::string& scratch) {
    const std::size_t len = std::strlen(utf8);
    if (isAscii(utf8, len)) {
        return std::string_view(utf8, len);
    }
    decode(reinterpret_cast<const unsigned char*>(utf8), len, scratch);
    return scratch;
}

}  // namespace Vesk
