// Decodes arbitrary text as Base64. Decoding skips blanks and line breaks and is strict about
// everything else, so whatever it accepts, without those, must be exactly what Encode writes for
// the decoded bytes.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <stdexcept>
#include <string>

#include "Quorvex/Base64Coder.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const char* text = reinterpret_cast<const char*>(data);
    std::size_t len = 0;
    Quorvex::ByteArray bytes;
    try {
        bytes = Base64Coder::Decode(text, size, len);
    } catch (const std::invalid_argument&) {
        return 0;
    }
    std::string significant;
    for (std::size_t i = 0; i < size; ++i) {
        const char c = text[i];
        if (c != ' ' && c != '\t' && c != '\r' && c != '\n') {
            significant += c;
        }
    }
    const ACE_CString again = Base64Coder::Encode(bytes.get(), len);
    if (again.length() != significant.size() ||
        std::memcmp(again.c_str(), significant.data(), significant.size()) != 0) {
        std::abort();
    }
    return 0;
}
