// Decodes arbitrary text as Base64. Decoding is strict, so whatever it accepts must be exactly
// what Encode writes for the decoded bytes.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <stdexcept>

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
    const ACE_CString again = Base64Coder::Encode(bytes.get(), len);
    if (again.length() != size || std::memcmp(again.c_str(), text, size) != 0) {
        std::abort();
    }
    return 0;
}
