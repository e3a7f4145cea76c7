// The file name that stands for an event name inside the event directory.
#pragma once

#include <ace/SString.h>

namespace Common {

// Drops a "Global\" or "Local\" namespace prefix and percent-encodes every byte outside
// [A-Za-z0-9._-], and a leading '.', so the result is never a path, "." or "..", nor hidden.
// Throws std::runtime_error when nothing is left of the name.
ACE_CString EventFileName(const ACE_CString& eventName);

}  // namespace Common
