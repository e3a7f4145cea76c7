// Comparison of host names: case-insensitive, and a short name stands for its fully qualified form.
#include "Quorvex/Host.h"

#include <cctype>
#include <cstddef>

namespace Quorvex {
namespace {

bool sameIgnoringCase(const char* a, std::size_t aLength, const char* b, std::size_t bLength) {
    if (aLength != bLength) {
        return false;
    }
    for (std::size_t i = 0; i < aLength; ++i) {
        if (std::tolower(static_cast<unsigned char>(a[i])) !=
            std::tolower(static_cast<unsigned char>(b[i]))) {
            return false;
        }
    }
    return true;
}

// Dotted-decimal addresses such as "10.0.0.1" have no short form: their first label is no name.
bool isNumericAddress(const ACE_CString& name) {
    for (std::size_t i = 0; i < name.length(); ++i) {
        const unsigned char c = static_cast<unsigned char>(name[i]);
        if (!std::isdigit(c) && c != '.') {
            return false;
        }
    }
    return true;
}

}  // namespace

bool HostNamesEquivalent(const ACE_CString& a, const ACE_CString& b) {
    if (a.length() == 0 || b.length() == 0) {
        return false;
    }
    if (sameIgnoringCase(a.c_str(), a.length(), b.c_str(), b.length())) {
        return true;
    }
    const ACE_CString::size_type aDot = a.find('.');
    const ACE_CString::size_type bDot = b.find('.');
    const bool aQualified = aDot != ACE_CString::npos;
    const bool bQualified = bDot != ACE_CString::npos;
    if (aQualified == bQualified) {
        return false;  // two short names, or two fully qualified names, that differ
    }
    const ACE_CString& qualified = aQualified ? a : b;
    const ACE_CString& shortName = aQualified ? b : a;
    if (isNumericAddress(qualified)) {
        return false;
    }
    return sameIgnoringCase(qualified.c_str(), aQualified ? aDot : bDot, shortName.c_str(),
                            shortName.length());
}

std::string HostKey(const std::string& host) {
    std::string key = host;
    for (char& c : key) {
        if (c >= 'A' && c <= 'Z') {
            c = static_cast<char>(c - 'A' + 'a');
        }
    }
    return key;
}

}  // namespace Quorvex
