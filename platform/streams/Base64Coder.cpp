// Table-driven Base64: three bytes become four characters. Decoding is strict so that every
// accepted text is exactly what Encode would write for its bytes.
#include "Quorvex/Base64Coder.h"

#include <array>
#include <cstdint>
#include <cstdio>
#include <stdexcept>
#include <string>

namespace {

constexpr char kAlphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr std::uint8_t kInvalid = 0xFF;

using DecodeTable = std::array<std::uint8_t, 256>;

constexpr DecodeTable makeDecodeTable() {
    DecodeTable table{};
    for (auto& entry : table) {
        entry = kInvalid;
    }
    for (std::uint8_t i = 0; i < 64; ++i) {
        table[static_cast<unsigned char>(kAlphabet[i])] = i;
    }
    return table;
}

constexpr DecodeTable kDecode = makeDecodeTable();

[[noreturn]] void reject(const std::string& why, std::size_t offset) {
    throw std::invalid_argument("Base64Coder::Decode: " + why + " at offset " +
                                std::to_string(offset));
}

// The 6-bit value of text[i]; anything outside the alphabet (also '=') is rejected.
std::uint32_t sextet(const char* text, std::size_t i) {
    const std::uint8_t v = kDecode[static_cast<unsigned char>(text[i])];
    if (v == kInvalid) {
        char shown[8];
        std::snprintf(shown, sizeof shown, "0x%02X", static_cast<unsigned char>(text[i]));
        reject(std::string(text[i] == '=' ? "misplaced padding " : "invalid character ") + shown,
               i);
    }
    return v;
}

// How many '=' end the text (0-2); padding elsewhere is caught by sextet().
std::size_t paddingOf(const char* text, std::size_t len) {
    if (len == 0 || text[len - 1] != '=') {
        return 0;
    }
    return text[len - 2] == '=' ? 2 : 1;
}

}  // namespace

ACE_CString Base64Coder::Encode(const unsigned char* data, std::size_t len) {
    std::string out((len + 2) / 3 * 4, '=');
    char* o = &out[0];
    std::size_t i = 0;
    for (; i + 3 <= len; i += 3, o += 4) {
        const std::uint32_t v = (std::uint32_t{data[i]} << 16) | (data[i + 1] << 8) | data[i + 2];
        o[0] = kAlphabet[v >> 18];
        o[1] = kAlphabet[(v >> 12) & 63];
        o[2] = kAlphabet[(v >> 6) & 63];
        o[3] = kAlphabet[v & 63];
    }
    if (i < len) {
        const bool two = i + 1 < len;
        const std::uint32_t v = (std::uint32_t{data[i]} << 16) | (two ? data[i + 1] << 8 : 0);
        o[0] = kAlphabet[v >> 18];
        o[1] = kAlphabet[(v >> 12) & 63];
        if (two) {
            o[2] = kAlphabet[(v >> 6) & 63];
        }
    }
    return ACE_CString(out.data(), out.size());
}

Quorvex::ByteArray Base64Coder::Decode(const char* text, std::size_t len, std::size_t& outLen) {
    if (len % 4 != 0) {
        throw std::invalid_argument("Base64Coder::Decode: length " + std::to_string(len) +
                                    " is not a multiple of 4");
    }
    const std::size_t pad = paddingOf(text, len);
    const std::size_t full = len == 0 ? 0 : (pad == 0 ? len : len - 4);  // unpadded quads
    outLen = len / 4 * 3 - pad;
    Quorvex::ByteArray bytes(new unsigned char[outLen]);
    unsigned char* o = bytes.get();
    const auto* in = reinterpret_cast<const unsigned char*>(text);
    for (std::size_t i = 0; i < full; i += 4, o += 3) {
        const std::uint8_t a = kDecode[in[i]], b = kDecode[in[i + 1]], c = kDecode[in[i + 2]],
                           d = kDecode[in[i + 3]];
        if (((a | b | c | d) & 0x80) != 0) {
            for (std::size_t k = i; k < i + 4; ++k) {
                sextet(text, k);  // throws for the first bad character
            }
        }
        const std::uint32_t v = (std::uint32_t{a} << 18) | (b << 12) | (c << 6) | d;
        o[0] = static_cast<unsigned char>(v >> 16);
        o[1] = static_cast<unsigned char>(v >> 8);
        o[2] = static_cast<unsigned char>(v);
    }
    if (pad > 0) {
        const std::size_t i = full;
        std::uint32_t v = (sextet(text, i) << 18) | (sextet(text, i + 1) << 12);
        if (pad == 1) {
            v |= sextet(text, i + 2) << 6;
        }
        if ((v & (pad == 1 ? 0xFFu : 0xFFFFu)) != 0) {
            reject("non-zero bits before the padding", i + 3 - pad);
        }
        o[0] = static_cast<unsigned char>(v >> 16);
        if (pad == 1) {
            o[1] = static_cast<unsigned char>(v >> 8);
        }
    }
    return bytes;
}
