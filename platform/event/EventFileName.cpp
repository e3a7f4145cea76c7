// Mapping of event names, which may hold any character, to safe file names.
#include "EventFileName.h"

#include <strings.h>

#include <cstring>
#include <stdexcept>

namespace Common {
namespace {

bool hasPrefix(const ACE_CString& text, const char* prefix) {
    const ACE_CString::size_type n = std::strlen(prefix);
    return text.length() >= n && strncasecmp(text.c_str(), prefix, n) == 0;
}

bool isPlain(char c) {
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '.' ||
           c == '_' || c == '-';
}

}  // namespace

ACE_CString EventFileName(const ACE_CString& eventName) {
    static const char* const kPrefixes[] = {"Global\\", "Local\\"};
    ACE_CString::size_type start = 0;
    for (const char* prefix : kPrefixes) {
        if (hasPrefix(eventName, prefix)) {
            start = std::strlen(prefix);
            break;
        }
    }
    if (start >= eventName.length()) {
        throw std::runtime_error("NamedEvent: empty event name");
    }
    static const char kHex[] = "0123456789ABCDEF";
    ACE_CString file;
    for (ACE_CString::size_type i = start; i < eventName.length(); ++i) {
        const char c = eventName[i];
        if (isPlain(c) && !(i == start && c == '.')) {
            file += c;
        } else {
            const unsigned char byte = static_cast<unsigned char>(c);
            file += '%';
            file += kHex[byte >> 4];
            file += kHex[byte & 0x0F];
        }
    }
    return file;
}

}  // namespace Common
