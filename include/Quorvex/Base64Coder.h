// Base64Coder: standard Base64 (RFC 4648 alphabet, '=' padding). Encode writes one line without
// breaks; Decode also reads text wrapped in lines or spaced out. Stateless and thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>

#include "Quorvex/auto_ptr.h"

class Base64Coder {
public:
    // The Base64 text of len bytes.
    static ACE_CString Encode(const unsigned char* data, std::size_t len);
    // The length of the Base64 text of len bytes.
    static std::size_t EncodedLength(std::size_t len) { return (len + 2) / 3 * 4; }
    // Writes the Base64 text of len bytes to out (room for EncodedLength(len) characters);
    // returns its length.
    static std::size_t EncodeInto(const unsigned char* data, std::size_t len, char* out);
    // Decodes text; the caller owns the bytes (length in outLen). Spaces, tabs, CR and LF are
    // skipped wherever they stand; any other character outside the alphabet, bad padding or a
    // count of the other characters that is not a multiple of four throw std::invalid_argument
    // (the message gives the offset in text as given).
    static Quorvex::ByteArray Decode(const char* text, std::size_t len, std::size_t& outLen);
    static Quorvex::ByteArray Decode(const ACE_CString& text, std::size_t& outLen) {
        return Decode(text.c_str(), text.length(), outLen);
    }
};
