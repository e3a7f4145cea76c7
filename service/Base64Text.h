// Base64Text: standard Base64 (RFC 4648 alphabet, '=' padding, no line breaks) written into a
// caller's buffer, for answers that carry documents. Stateless; thread-safe.
#pragma once

#include <cstddef>

namespace ConfigurationService {
namespace Base64Text {

// The length of the Base64 text of length bytes.
inline std::size_t encodedLength(std::size_t length) {
    return (length + 2) / 3 * 4;
}

// Writes the Base64 text of length bytes to out (room for encodedLength(length) characters);
// returns its length.
std::size_t encode(const unsigned char* in, std::size_t length, char* out);

}  // namespace Base64Text
}  // namespace ConfigurationService
