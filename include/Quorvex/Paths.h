// Windows-style path helpers. Stored configuration values are Windows paths ("D:\Quorvex\input\"),
// so these work on backslash-separated text whatever the platform. Pure functions; thread-safe.
#pragma once

#include <ace/SString.h>

namespace Quorvex {

// Both '\' and '/' are read as separators; a separator these functions add is always '\'.

// The drive element of a path with its separator: "C:\" for "C:\a\b" (and for "C:"),
// "\\server\share\" for a UNC path, "/" for an absolute Linux path, "\" for a rooted one, empty
// for a relative path.
ACE_CString getDriveElement(const ACE_CString& path);
// Everything but the last element, without a trailing separator: "C:\a\b\" and "C:\a\b" give
// "C:\a", "C:\a" gives "C:"; a lone drive gives itself without its separator ("C:\" gives "C:",
// "/" gives ""); a single relative element gives "".
ACE_CString getAllButLastPathElement(const ACE_CString& path);
// Joins two paths with exactly one '\' between them, b taken as relative to a ("C:\" and "x\"
// give "C:\x\"); an empty side gives the other unchanged.
ACE_CString concatPath(const ACE_CString& a, const ACE_CString& b);
// Turns '/' into '\', folds repeated separators (keeping a leading "\\" of a UNC path), and
// resolves "." and ".." elements; a trailing separator is kept. ".." never climbs above a drive or
// UNC share (it is dropped) but is kept at the start of a relative path; a relative path that
// resolves to nothing gives ".".
ACE_CString normalizePath(const ACE_CString& path);

}  // namespace Quorvex
