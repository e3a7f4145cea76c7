// Header writing and strict parsing of item files.
#include "ItemFile.h"

#include <cerrno>
#include <cstdlib>

#include "StoreFileName.h"

namespace Configuration {
namespace {

const char kMagic[] = "QVXITEM1";

// Reads the line starting at pos (without its '\n'); false when there is no complete line.
bool nextLine(const std::string& content, std::size_t& pos, std::string& line) {
    const std::size_t end = content.find('\n', pos);
    if (end == std::string::npos) {
        return false;
    }
    line.assign(content, pos, end - pos);
    pos = end + 1;
    return true;
}

bool parseNumber(const std::string& text, long long& value) {
    if (text.empty() || text.size() > 20) {
        return false;
    }
    char* end = nullptr;
    errno = 0;
    value = std::strtoll(text.c_str(), &end, 10);
    return errno == 0 && end == text.c_str() + text.size();
}

}  // namespace

std::string ItemFile::header(const std::string& host, const std::string& name,
                             std::int64_t lastModifiedMs, std::size_t dataSize) {
    std::string text = kMagic;
    text += '\n';
    text += std::to_string(lastModifiedMs) + '\n';
    text += StoreFileName::encode(host) + '\n';
    text += StoreFileName::encode(name) + '\n';
    text += std::to_string(dataSize) + '\n';
    return text;
}

bool ItemFile::parse(const std::string& content, Parsed& parsed) {
    std::size_t pos = 0;
    std::string magic, time, host, name, size;
    if (!nextLine(content, pos, magic) || magic != kMagic || !nextLine(content, pos, time) ||
        !nextLine(content, pos, host) || !nextLine(content, pos, name) ||
        !nextLine(content, pos, size)) {
        return false;
    }
    long long ms = 0;
    long long bytes = 0;
    if (!parseNumber(time, ms) || !parseNumber(size, bytes) || bytes < 0 ||
        static_cast<unsigned long long>(bytes) != content.size() - pos) {
        return false;
    }
    if (!StoreFileName::decode(host, parsed.host) || !StoreFileName::decode(name, parsed.name) ||
        parsed.host.empty() || parsed.name.empty()) {
        return false;
    }
    parsed.lastModifiedMs = ms;
    parsed.dataOffset = pos;
    parsed.dataSize = static_cast<std::size_t>(bytes);
    return true;
}

}  // namespace Configuration
