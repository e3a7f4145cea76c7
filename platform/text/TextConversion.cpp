// UTF-8 to ISO-8859-1 through iconv.
#include "Quorvex/TextConversion.h"

#include <iconv.h>

#include <cerrno>
#include <cstddef>
#include <cstring>
#include <stdexcept>
#include <string>

namespace Quorvex {
namespace {

// Input is handed to iconv in windows of this many bytes: after a failure glibc converts the whole
// window again to find the failing position, so a short window keeps failures cheap.
const std::size_t kWindow = 64;

bool isContinuation(unsigned char c) {
    return (c & 0xC0) == 0x80;
}

// The allowed range of the second byte of a sequence that starts with lead (Unicode table 3-7);
// false when lead starts no sequence.
bool secondByteRange(unsigned char lead, unsigned char& low, unsigned char& high) {
    low = 0x80;
    high = 0xBF;
    if (lead < 0xC2 || lead > 0xF4) {
        return false;
    }
    if (lead == 0xE0) {
        low = 0xA0;
    } else if (lead == 0xED) {
        high = 0x9F;
    } else if (lead == 0xF0) {
        low = 0x90;
    } else if (lead == 0xF4) {
        high = 0x8F;
    }
    return true;
}

// How many bytes one '?' stands for at p: a whole well-formed character that the code page cannot
// hold, or the longest start of a sequence that could still have become well-formed (at least one
// byte), so that a truncated character gives one '?' and the bytes after it are read afresh.
std::size_t replacedLength(const unsigned char* p, std::size_t available) {
    unsigned char low = 0;
    unsigned char high = 0;
    if (!secondByteRange(p[0], low, high)) {
        return 1;
    }
    const std::size_t expected = p[0] < 0xE0 ? 2 : p[0] < 0xF0 ? 3 : 4;
    std::size_t length = 1;
    while (length < expected && length < available) {
        const unsigned char c = p[length];
        const bool ok = length == 1 ? (c >= low && c <= high) : isContinuation(c);
        if (!ok) {
            break;
        }
        ++length;
    }
    return length;
}

// An iconv descriptor for one conversion, closed at the end of the scope.
class Converter {
public:
    Converter() : m_cd(iconv_open("ISO-8859-1", "UTF-8")) {
        if (m_cd == reinterpret_cast<iconv_t>(-1)) {
            throw std::runtime_error("ConvertUTF8StringToAnsi: iconv_open failed");
        }
    }
    ~Converter() { iconv_close(m_cd); }
    Converter(const Converter&) = delete;
    Converter& operator=(const Converter&) = delete;
    iconv_t get() const { return m_cd; }

private:
    iconv_t m_cd;
};

}  // namespace

void ConvertUTF8StringToAnsi(const ACE_CString& utf8, ACE_CString& ansi) {
    Converter converter;
    const std::size_t total = utf8.length();
    char* in = const_cast<char*>(utf8.c_str());
    const char* const inEnd = in + total;
    // One output byte per character is never more than one per input byte.
    std::string out(total + 1, '\0');
    char* const outStart = &out[0];
    char* outPos = outStart;
    std::size_t outLeft = total + 1;
    while (in < inEnd) {
        const std::size_t remaining = static_cast<std::size_t>(inEnd - in);
        const bool lastWindow = remaining <= kWindow;
        std::size_t windowLeft = lastWindow ? remaining : kWindow;
        if (iconv(converter.get(), &in, &windowLeft, &outPos, &outLeft) !=
            static_cast<std::size_t>(-1)) {
            continue;
        }
        if (errno == EINVAL && !lastWindow) {
            continue;  // a character cut by the window: the next window starts with it
        }
        if (errno != EILSEQ && errno != EINVAL) {
            throw std::runtime_error(std::string("ConvertUTF8StringToAnsi: ") +
                                     std::strerror(errno));
        }
        const std::size_t skip = replacedLength(reinterpret_cast<const unsigned char*>(in),
                                                static_cast<std::size_t>(inEnd - in));
        *outPos++ = '?';
        --outLeft;
        in += skip;
    }
    ansi = ACE_CString(outStart, static_cast<ACE_CString::size_type>(outPos - outStart));
}

}  // namespace Quorvex
