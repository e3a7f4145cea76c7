// Percent-encoding of host and configuration names into safe, reversible file names.
#include "StoreFileName.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>

namespace Configuration {
namespace {

bool isSafe(unsigned char c) {
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '.' ||
           c == '_' || c == '-';
}

int hexValue(char c) {
    if (c >= '0' && c <= '9') {
        return c - '0';
    }
    if (c >= 'A' && c <= 'F') {
        return c - 'A' + 10;
    }
    return -1;
}

// FNV-1a over the key with a given offset basis; two bases give 128 bits of name hash.
std::uint64_t fnv1a(const std::string& text, std::uint64_t basis) {
    std::uint64_t hash = basis;
    for (unsigned char c : text) {
        hash = (hash ^ c) * 1099511628211ull;
    }
    return hash;
}

// Cuts an encoded text to at most max bytes without splitting a "%XX" triple.
std::string truncateEncoded(const std::string& encoded, std::size_t max) {
    std::size_t cut = std::min(max, encoded.size());
    for (std::size_t back = 1; back <= 2 && cut >= back; ++back) {
        if (encoded[cut - back] == '%') {
            cut -= back;
            break;
        }
    }
    return encoded.substr(0, cut);
}

}  // namespace

std::string StoreFileName::encode(const std::string& text) {
    static const char digits[] = "0123456789ABCDEF";
    std::string out;
    out.reserve(text.size() + 8);
    for (std::size_t i = 0; i < text.size(); ++i) {
        const unsigned char c = static_cast<unsigned char>(text[i]);
        if (isSafe(c) && !(i == 0 && c == '.')) {
            out += static_cast<char>(c);
        } else {
            out += '%';
            out += digits[c >> 4];
            out += digits[c & 0x0F];
        }
    }
    return out;
}

bool StoreFileName::decode(const std::string& encoded, std::string& text) {
    text.clear();
    for (std::size_t i = 0; i < encoded.size(); ++i) {
        const char c = encoded[i];
        if (c != '%') {
            if (!isSafe(static_cast<unsigned char>(c))) {
                return false;
            }
            text += c;
            continue;
        }
        if (i + 2 >= encoded.size()) {
            return false;
        }
        const int high = hexValue(encoded[i + 1]);
        const int low = hexValue(encoded[i + 2]);
        if (high < 0 || low < 0) {
            return false;
        }
        text += static_cast<char>(high * 16 + low);
        i += 2;
    }
    return true;
}

std::string StoreFileName::item(const std::string& host, const std::string& name) {
    std::string full = encode(host) + "~" + encode(name);
    if (full.size() <= kMaxLength) {
        return full;
    }
    const std::string key = host + std::string(1, '\0') + name;
    char hash[40];
    std::snprintf(hash, sizeof hash, "%016llx%016llx",
                  static_cast<unsigned long long>(fnv1a(key, 14695981039346656037ull)),
                  static_cast<unsigned long long>(fnv1a(key, 0x84222325cbf29ce4ull)));
    return truncateEncoded(full, kMaxLength - 34) + "~~" + hash;
}

bool StoreFileName::isItemFile(const std::string& fileName) {
    return !fileName.empty() && fileName[0] != '.' && fileName.find('~') != std::string::npos;
}

}  // namespace Configuration
