// Host facts: thin answers from the machine in effect, so tests can replace the machine.
#include "Quorvex/Host.h"

#include "Quorvex/Machine.h"

namespace Quorvex {

ACE_CString GetHostName(bool fullyQualified) {
    return CurrentMachine().hostName(fullyQualified);
}

int GetLocalIPAddress(ACE_CString& address) {
    return CurrentMachine().localIPAddress(address) ? 0 : -1;
}

std::vector<ACE_CString> GetLogicalDriveList() {
    return CurrentMachine().logicalDrives();
}

ACE_CString GetExecutablePath() {
    return CurrentMachine().executablePath();
}

bool IsClusterNode() {
    return CurrentMachine().isClusterNode();
}

bool GetEnvironmentVariable(const char* name, ACE_CString& value) {
    return CurrentMachine().environment(name, value);
}

}  // namespace Quorvex
