// Base64 three bytes at a time, two characters per look-up.
#include "Base64Text.h"

#include <cstring>

namespace ConfigurationService {
namespace Base64Text {
namespace {

const char kAlphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

// The two characters of every 12-bit group: half the look-ups of one character at a time.
struct PairTable {
    char pairs[4096][2];
    PairTable() {
        for (unsigned v = 0; v < 4096; ++v) {
            pairs[v][0] = kAlphabet[v >> 6];
            pairs[v][1] = kAlphabet[v & 63];
        }
    }
};

const PairTable& pairTable() {
    static const PairTable table;
    return table;
}

}  // namespace

std::size_t encode(const unsigned char* in, std::size_t length, char* out) {
    const PairTable& table = pairTable();
    char* const start = out;
    std::size_t i = 0;
    for (; i + 3 <= length; i += 3) {
        const unsigned v = (unsigned(in[i]) << 16) | (unsigned(in[i + 1]) << 8) | in[i + 2];
        std::memcpy(out, table.pairs[v >> 12], 2);
        std::memcpy(out + 2, table.pairs[v & 0xfff], 2);
        out += 4;
    }
    if (i < length) {
        const bool two = i + 1 < length;
        const unsigned v = (unsigned(in[i]) << 16) | (two ? unsigned(in[i + 1]) << 8 : 0u);
        out[0] = kAlphabet[v >> 18];
        out[1] = kAlphabet[(v >> 12) & 63];
        out[2] = two ? kAlphabet[(v >> 6) & 63] : '=';
        out[3] = '=';
        out += 4;
    }
    return static_cast<std::size_t>(out - start);
}

}  // namespace Base64Text
}  // namespace ConfigurationService
