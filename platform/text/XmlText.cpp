// Decoding of XML character entities into 8-bit text.
#include "Quorvex/TextConversion.h"

#include <cstddef>
#include <cstring>
#include <string>

namespace Quorvex {
namespace {

using Size = ACE_CString::size_type;

// The longest entity worth looking at: "&#x000000FF;" and the like.
const Size kMaxEntityLength = 12;

int digitValue(char c, int base) {
    if (c >= '0' && c <= '9') {
        return c - '0';
    }
    if (base == 16 && c >= 'a' && c <= 'f') {
        return c - 'a' + 10;
    }
    if (base == 16 && c >= 'A' && c <= 'F') {
        return c - 'A' + 10;
    }
    return -1;
}

// A numeric character reference body ("#65", "#xE9"): its character when it is 1 to 255.
bool numericCharacter(const char* body, std::size_t length, char& out) {
    const bool hex = length > 1 && (body[1] == 'x' || body[1] == 'X');
    const int base = hex ? 16 : 10;
    std::size_t i = hex ? 2 : 1;
    if (i >= length) {
        return false;
    }
    int value = 0;
    for (; i < length; ++i) {
        const int digit = digitValue(body[i], base);
        if (digit < 0) {
            return false;
        }
        value = value * base + digit;
        if (value > 255) {
            return false;
        }
    }
    if (value == 0) {
        return false;
    }
    out = static_cast<char>(static_cast<unsigned char>(value));
    return true;
}

// The character an entity body (the text between '&' and ';') stands for.
bool entityCharacter(const char* body, std::size_t length, char& out) {
    static const struct {
        const char* name;
        char character;
    } kNamed[] = {{"lt", '<'}, {"gt", '>'}, {"amp", '&'}, {"quot", '"'}, {"apos", '\''}};
    if (length > 0 && body[0] == '#') {
        return numericCharacter(body, length, out);
    }
    for (const auto& named : kNamed) {
        if (std::strlen(named.name) == length && std::strncmp(named.name, body, length) == 0) {
            out = named.character;
            return true;
        }
    }
    return false;
}

// The position of the ';' that closes an entity opened at pos, or npos when none is near enough.
Size entityEnd(const char* data, Size length, Size pos) {
    const Size limit = pos + kMaxEntityLength < length ? pos + kMaxEntityLength + 1 : length;
    for (Size i = pos + 1; i < limit; ++i) {
        if (data[i] == ';') {
            return i;
        }
        if (data[i] == '&') {
            break;
        }
    }
    return ACE_CString::npos;
}

}  // namespace

void ConvertXmlStringToString(const ACE_CString& xml, ACE_CString& text) {
    const char* data = xml.c_str();
    const Size length = xml.length();
    std::string out;
    out.reserve(length);
    Size pos = 0;
    while (pos < length) {
        char decoded = 0;
        const Size semicolon = data[pos] == '&' ? entityEnd(data, length, pos) : ACE_CString::npos;
        if (semicolon != ACE_CString::npos &&
            entityCharacter(data + pos + 1, semicolon - pos - 1, decoded)) {
            out += decoded;
            pos = semicolon + 1;
        } else {
            out += data[pos];
            ++pos;
        }
    }
    text = ACE_CString(out.data(), static_cast<Size>(out.size()));
}

}  // namespace Quorvex
