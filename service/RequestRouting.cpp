// Paths of request targets and the quick operations.
#include "RequestRouting.h"

#include <algorithm>
#include <cctype>
#include <cstring>

namespace ConfigurationService {
namespace RequestRouting {
namespace {

bool startsWithNoCase(const std::string& text, const char* prefix) {
    const std::size_t length = std::strlen(prefix);
    if (text.size() < length) {
        return false;
    }
    for (std::size_t i = 0; i < length; ++i) {
        if (std::tolower(static_cast<unsigned char>(text[i])) != prefix[i]) {
            return false;
        }
    }
    return true;
}

bool isNameChar(char c) {
    return std::isalnum(static_cast<unsigned char>(c)) || c == '_' || c == '-' || c == '.' ||
           c == ':';
}

// Operations that only read the in-memory store or the service's own facts.
const char* const kQuick[] = {"Retrieve",  "Exists",    "GetLastModifiedTime",   "GetHostName",
                              "ListHosts", "ListItems", "ListHostsByModuleType", "GetServerInfo"};

}  // namespace

std::string path(const std::string& target) {
    std::size_t start = 0;
    for (const char* scheme : {"http://", "https://"}) {
        if (startsWithNoCase(target, scheme)) {
            start = target.find('/', std::strlen(scheme));
            if (start == std::string::npos) {
                return "/";
            }
            break;
        }
    }
    if (start == 0 && (target.empty() || target[0] != '/')) {
        return target;
    }
    const std::size_t end = target.find_first_of("?#", start);
    return target.substr(start, end == std::string::npos ? std::string::npos : end - start);
}

std::string rootName(const std::string& body) {
    std::size_t at = 0;
    // Skips white space, a byte-order mark, the XML declaration and comments; a document type
    // declaration ends the search.
    for (;;) {
        at = body.find('<', at);
        if (at == std::string::npos || at + 1 >= body.size()) {
            return std::string();
        }
        const char* close = body.compare(at, 4, "<!--") == 0 ? "-->"
                            : body[at + 1] == '?'            ? "?>"
                                                             : nullptr;
        if (close == nullptr) {
            break;
        }
        at = body.find(close, at + 2);
        if (at == std::string::npos) {
            return std::string();
        }
    }
    std::size_t end = at + 1;
    while (end < body.size() && isNameChar(body[end])) {
        ++end;
    }
    return body.substr(at + 1, end - at - 1);
}

bool isQuick(const std::string& body) {
    if (body.size() > kQuickBodyBytes) {
        return false;
    }
    const std::string name = rootName(body);
    return std::find(std::begin(kQuick), std::end(kQuick), name) != std::end(kQuick);
}

}  // namespace RequestRouting
}  // namespace ConfigurationService
