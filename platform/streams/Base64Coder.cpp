// Table-driven Base64: three bytes become four characters. Decoding skips blanks and line breaks
// (wrapped answers) and is strict about everything else, so that every accepted text, without its
// blanks, is exactly what Encode would write for its bytes.
#include "Quorvex/Base64Coder.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <iterator>
#include <stdexcept>
#include <string>
#include <utility>

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

// The two characters of every 12-bit group: the encoder makes half the look-ups of one
// character at a time.
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

// ASCII blanks and line breaks, which wrapped Base64 carries between its characters.
bool isBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// The text being decoded without its blanks, and where each of its characters stood in the text
// as given, so that errors name the offset the caller sees.
class Significant {
public:
    Significant(const char* text, std::size_t len) : m_given(text), m_givenLength(len) {
        if (std::find_if(text, text + len, isBlank) == text + len) {
            m_text = text;
            m_length = len;
            return;
        }
        m_compact.reserve(len);
        std::remove_copy_if(text, text + len, std::back_inserter(m_compact), isBlank);
        m_text = m_compact.data();
        m_length = m_compact.size();
    }
    Significant(const Significant&) = delete;
    Significant& operator=(const Significant&) = delete;

    const char* text() const { return m_text; }
    std::size_t length() const { return m_length; }
    bool hadBlanks() const { return m_text != m_given; }

    // The offset in the given text of the i-th significant character.
    std::size_t givenOffset(std::size_t i) const {
        if (!hadBlanks()) {
            return i;
        }
        std::size_t at = 0;
        for (std::size_t seen = 0; at < m_givenLength; ++at) {
            if (!isBlank(m_given[at]) && seen++ == i) {
                break;
            }
        }
        return at;
    }

private:
    const char* m_given;
    std::size_t m_givenLength;
    std::string m_compact;
    const char* m_text = nullptr;
    std::size_t m_length = 0;
};

[[noreturn]] void reject(const std::string& why, std::size_t offset) {
    throw std::invalid_argument("Base64Coder::Decode: " + why + " at offset " +
                                std::to_string(offset));
}

// The 6-bit value of the i-th significant character; anything outside the alphabet (also '=') is
// rejected.
std::uint32_t sextet(const Significant& in, std::size_t i) {
    const char c = in.text()[i];
    const std::uint8_t v = kDecode[static_cast<unsigned char>(c)];
    if (v == kInvalid) {
        char shown[8];
        std::snprintf(shown, sizeof shown, "0x%02X", static_cast<unsigned char>(c));
        reject(std::string(c == '=' ? "misplaced padding " : "invalid character ") + shown,
               in.givenOffset(i));
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

// The common case in one pass: a text without blanks and without faults, decoded straight into
// its buffer. False, with bytes and outLen untouched, for anything else (blanks, a bad character
// or length, an empty text), which the careful decoder then handles and reports.
bool decodeCompact(const char* text, std::size_t len, Quorvex::ByteArray& bytes,
                   std::size_t& outLen) {
    if (len == 0 || len % 4 != 0) {
        return false;
    }
    const auto* u = reinterpret_cast<const unsigned char*>(text);
    const std::size_t pad = paddingOf(text, len);
    const std::size_t full = pad == 0 ? len : len - 4;
    const std::size_t size = len / 4 * 3 - pad;
    Quorvex::ByteArray out(new unsigned char[size]);
    unsigned char* o = out.get();
    for (std::size_t i = 0; i < full; i += 4, o += 3) {
        const std::uint8_t a = kDecode[u[i]], b = kDecode[u[i + 1]], c = kDecode[u[i + 2]],
                           d = kDecode[u[i + 3]];
        if (((a | b | c | d) & 0x80) != 0) {
            return false;
        }
        const std::uint32_t v = (std::uint32_t{a} << 18) | (b << 12) | (c << 6) | d;
        o[0] = static_cast<unsigned char>(v >> 16);
        o[1] = static_cast<unsigned char>(v >> 8);
        o[2] = static_cast<unsigned char>(v);
    }
    if (pad > 0) {
        const std::uint8_t a = kDecode[u[full]], b = kDecode[u[full + 1]],
                           c = pad == 1 ? kDecode[u[full + 2]] : 0;
        const std::uint32_t v = (std::uint32_t{a} << 18) | (b << 12) | (c << 6);
        if (((a | b | c) & 0x80) != 0 || (v & (pad == 1 ? 0xFFu : 0xFFFFu)) != 0) {
            return false;
        }
        o[0] = static_cast<unsigned char>(v >> 16);
        if (pad == 1) {
            o[1] = static_cast<unsigned char>(v >> 8);
        }
    }
    bytes = std::move(out);
    outLen = size;
    return true;
}

}  // namespace

ACE_CString Base64Coder::Encode(const unsigned char* data, std::size_t len) {
    std::string out(EncodedLength(len), '\0');
    EncodeInto(data, len, &out[0]);
    return ACE_CString(out.data(), out.size());
}

std::size_t Base64Coder::EncodeInto(const unsigned char* data, std::size_t len, char* out) {
    const PairTable& table = pairTable();
    char* const start = out;
    std::size_t i = 0;
    for (; i + 3 <= len; i += 3, out += 4) {
        const std::uint32_t v = (std::uint32_t{data[i]} << 16) | (data[i + 1] << 8) | data[i + 2];
        std::memcpy(out, table.pairs[v >> 12], 2);
        std::memcpy(out + 2, table.pairs[v & 0xfff], 2);
    }
    if (i < len) {
        const bool two = i + 1 < len;
        const std::uint32_t v = (std::uint32_t{data[i]} << 16) | (two ? data[i + 1] << 8 : 0);
        out[0] = kAlphabet[v >> 18];
        out[1] = kAlphabet[(v >> 12) & 63];
        out[2] = two ? kAlphabet[(v >> 6) & 63] : '=';
        out[3] = '=';
        out += 4;
    }
    return static_cast<std::size_t>(out - start);
}

Quorvex::ByteArray Base64Coder::Decode(const char* given, std::size_t givenLength,
                                       std::size_t& outLen) {
    Quorvex::ByteArray compact;
    if (decodeCompact(given, givenLength, compact, outLen)) {
        return compact;
    }
    const Significant in(given, givenLength);
    const char* text = in.text();
    const std::size_t len = in.length();
    if (len % 4 != 0) {
        throw std::invalid_argument("Base64Coder::Decode: length " + std::to_string(len) +
                                    (in.hadBlanks() ? " without blanks" : "") +
                                    " is not a multiple of 4");
    }
    const std::size_t pad = paddingOf(text, len);
    const std::size_t full = len == 0 ? 0 : (pad == 0 ? len : len - 4);  // unpadded quads
    outLen = len / 4 * 3 - pad;
    Quorvex::ByteArray bytes(new unsigned char[outLen]);
    unsigned char* o = bytes.get();
    const auto* u = reinterpret_cast<const unsigned char*>(text);
    for (std::size_t i = 0; i < full; i += 4, o += 3) {
        const std::uint8_t a = kDecode[u[i]], b = kDecode[u[i + 1]], c = kDecode[u[i + 2]],
                           d = kDecode[u[i + 3]];
        if (((a | b | c | d) & 0x80) != 0) {
            for (std::size_t k = i; k < i + 4; ++k) {
                sextet(in, k);  // throws for the first bad character
            }
        }
        const std::uint32_t v = (std::uint32_t{a} << 18) | (b << 12) | (c << 6) | d;
        o[0] = static_cast<unsigned char>(v >> 16);
        o[1] = static_cast<unsigned char>(v >> 8);
        o[2] = static_cast<unsigned char>(v);
    }
    if (pad > 0) {
        const std::size_t i = full;
        std::uint32_t v = (sextet(in, i) << 18) | (sextet(in, i + 1) << 12);
        if (pad == 1) {
            v |= sextet(in, i + 2) << 6;
        }
        if ((v & (pad == 1 ? 0xFFu : 0xFFFFu)) != 0) {
            reject("non-zero bits before the padding", in.givenOffset(i + 3 - pad));
        }
        o[0] = static_cast<unsigned char>(v >> 16);
        if (pad == 1) {
            o[1] = static_cast<unsigned char>(v >> 8);
        }
    }
    return bytes;
}
