// Windows-style path helpers working on text. Both '\' and '/' are read as separators; what these
// functions add is always '\'.
#include "Quorvex/Paths.h"

#include <cctype>
#include <cstddef>
#include <vector>

namespace Quorvex {
namespace {

using Size = ACE_CString::size_type;

bool isSeparator(char c) {
    return c == '\\' || c == '/';
}

bool endsWithSeparator(const ACE_CString& path) {
    return path.length() > 0 && isSeparator(path[path.length() - 1]);
}

Size skipSeparators(const ACE_CString& path, Size pos) {
    while (pos < path.length() && isSeparator(path[pos])) {
        ++pos;
    }
    return pos;
}

Size skipName(const ACE_CString& path, Size pos) {
    while (pos < path.length() && !isSeparator(path[pos])) {
        ++pos;
    }
    return pos;
}

// Length of the "\\server\share\" prefix of a path that starts with two separators, or 0 when no
// server name follows them.
Size uncRootLength(const ACE_CString& path) {
    const Size server = skipSeparators(path, 0);
    if (server == path.length()) {
        return 0;
    }
    const Size share = skipSeparators(path, skipName(path, server));
    const Size end = skipName(path, share);
    return end < path.length() ? end + 1 : end;
}

// Length of the drive element at the start of a path, separator included when present: "C:\",
// "C:", "\\server\share\", "\" or "/"; 0 for a relative path.
Size rootLength(const ACE_CString& path) {
    const Size n = path.length();
    if (n >= 2 && std::isalpha(static_cast<unsigned char>(path[0])) && path[1] == ':') {
        return n > 2 && isSeparator(path[2]) ? 3 : 2;
    }
    if (n >= 2 && isSeparator(path[0]) && isSeparator(path[1])) {
        const Size unc = uncRootLength(path);
        return unc > 0 ? unc : 1;
    }
    return n >= 1 && isSeparator(path[0]) ? 1 : 0;
}

// The path without the separators at its end.
ACE_CString trimTrailingSeparators(const ACE_CString& path, Size keep) {
    Size end = path.length();
    while (end > keep && isSeparator(path[end - 1])) {
        --end;
    }
    return path.substr(0, end);
}

// The elements after the root with "." dropped and ".." resolved; a ".." that would climb above
// a root is dropped, above a relative start it is kept.
std::vector<ACE_CString> resolvedElements(const ACE_CString& path, Size start, bool rooted) {
    std::vector<ACE_CString> elements;
    Size pos = skipSeparators(path, start);
    while (pos < path.length()) {
        const Size end = skipName(path, pos);
        const ACE_CString element = path.substr(pos, end - pos);
        if (element == "..") {
            if (!elements.empty() && elements.back() != "..") {
                elements.pop_back();
            } else if (!rooted) {
                elements.push_back(element);
            }
        } else if (element != ".") {
            elements.push_back(element);
        }
        pos = skipSeparators(path, end);
    }
    return elements;
}

// The root with '/' turned into '\' and runs of separators folded (a UNC root keeps its "\\").
ACE_CString normalizedRoot(const ACE_CString& root) {
    ACE_CString out;
    for (Size i = 0; i < root.length(); ++i) {
        const bool separator = isSeparator(root[i]);
        if (separator && i >= 2 && endsWithSeparator(out)) {
            continue;
        }
        out += separator ? '\\' : root[i];
    }
    return out;
}

}  // namespace

ACE_CString getDriveElement(const ACE_CString& path) {
    ACE_CString drive = path.substr(0, rootLength(path));
    if (drive.length() > 0 && !endsWithSeparator(drive)) {
        drive += '\\';
    }
    return drive;
}

ACE_CString getAllButLastPathElement(const ACE_CString& path) {
    const Size root = rootLength(path);
    const ACE_CString trimmed = trimTrailingSeparators(path, root);
    Size end = trimmed.length();
    while (end > root && !isSeparator(trimmed[end - 1])) {
        --end;
    }
    return trimTrailingSeparators(trimmed.substr(0, end), 0);
}

ACE_CString concatPath(const ACE_CString& a, const ACE_CString& b) {
    if (a.length() == 0) {
        return b;
    }
    if (b.length() == 0) {
        return a;
    }
    ACE_CString joined = trimTrailingSeparators(a, 0);
    joined += '\\';
    joined += b.substr(skipSeparators(b, 0));
    return joined;
}

ACE_CString normalizePath(const ACE_CString& path) {
    const Size root = rootLength(path);
    const bool rooted = root > 0 && isSeparator(path[root - 1]);
    const std::vector<ACE_CString> elements = resolvedElements(path, root, rooted);
    ACE_CString out = normalizedRoot(path.substr(0, root));
    for (std::size_t i = 0; i < elements.size(); ++i) {
        if (i > 0) {
            out += '\\';
        }
        out += elements[i];
    }
    if (out.length() == 0) {
        return path.length() > 0 ? ACE_CString(".") : out;
    }
    if (!elements.empty() && endsWithSeparator(path)) {
        out += '\\';
    }
    return out;
}

}  // namespace Quorvex
