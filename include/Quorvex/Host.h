// Host and machine facts, answered by Quorvex::CurrentMachine(). Thread-safe.
#pragma once

#include <ace/SString.h>

#include <string>
#include <vector>

namespace Quorvex {

// This machine's host name: short when fullyQualified is false; empty on failure.
ACE_CString GetHostName(bool fullyQualified);
// The first non-loopback IPv4 address; returns 0 on success, non-zero on failure.
int GetLocalIPAddress(ACE_CString& address);
// Whether two host names name the same host: equal ignoring case, or one is the short form of
// the other's fully qualified name ("orvel1" and "ORVEL1.site.local"). Two different qualified
// names differ ("a.x", "a.y"); a dotted IPv4 address has no short form; an empty name matches
// nothing.
bool HostNamesEquivalent(const ACE_CString& a, const ACE_CString& b);
// The form under which a host name is keyed and compared without regard to case: ASCII letters
// lower-cased, every other byte kept (independent of the locale, so stored keys never change).
std::string HostKey(const std::string& host);
// The machine's logical drives ("C:\", ...); empty on Linux.
std::vector<ACE_CString> GetLogicalDriveList();
// The full path of the running executable.
ACE_CString GetExecutablePath();
// Whether this machine is a failover-cluster node (on Linux: see Quorvex::Machine).
bool IsClusterNode();
// An environment variable's value; false when it is not set.
bool GetEnvironmentVariable(const char* name, ACE_CString& value);

}  // namespace Quorvex
