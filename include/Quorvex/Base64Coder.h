// Base64Coder: standard Base64 (RFC 4648 alphabet, '=' padding, no line breaks). Stateless and
// thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>

#include "Quorvex/auto_ptr.h"

class Base64Coder {
public:
    // The Base64 text of len bytes.
    static ACE_CString Encode(const unsigned char* data, std::size_t len);
    // Decodes text; the caller owns the bytes (length in outLen). Characters outside the
    // alphabet, bad padding or a length that is not a multiple of four throw std::invalid_argument.
    static Quorvex::ByteArray Decode(const char* text, std::size_t len, std::size_t& outLen);
    static Quorvex::ByteArray Decode(const ACE_CString& text, std::size_t& outLen) {
        return Decode(text.c_str(), text.length(), outLen);
    }
};
