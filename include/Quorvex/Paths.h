// Windows-style path helpers. Stored configuration values are Windows paths ("D:\Quorvex\input\"),
// so these work on backslash-separated text whatever the platform. Pure functions; thread-safe.
#pragma once

#include <ace/SString.h>

namespace Quorvex {

// The drive element of a path with its separator: "C:\" for "C:\a\b", "\\server\share\" for a UNC
// path, "/" for an absolute Linux path, empty when there is none.
ACE_CString getDriveElement(const ACE_CString& path);
// Everything but the last element, without a trailing separator: "C:\a\b\" and "C:\a\b" give
// "C:\a"; a lone drive gives itself without its separator.
ACE_CString getAllButLastPathElement(const ACE_CString& path);
// Joins two paths with exactly one separator between them.
ACE_CString concatPath(const ACE_CString& a, const ACE_CString& b);
// Turns '/' into '\', folds repeated separators (keeping a leading "\\" of a UNC path), and
// resolves "." and ".." elements; a trailing separator is kept.
ACE_CString normalizePath(const ACE_CString& path);

}  // namespace Quorvex
