// FakeMachine: the facts a test sets, and a clock that starts at a fixed instant.
#include "FakeMachine.h"

namespace Quorvex {
namespace Testing {
namespace {

// 2010-03-04T05:06:07Z in milliseconds since 1970-01-01.
const std::int64_t kStartMilliseconds = 1267679167000;

}  // namespace

FakeMachine::FakeMachine() : m_now(kStartMilliseconds) {}

ACE_CString FakeMachine::hostName(bool fullyQualified) const {
    if (!fullyQualified || domain.length() == 0) {
        return shortName;
    }
    return shortName + "." + domain;
}

bool FakeMachine::localIPAddress(ACE_CString& address) const {
    if (ipAddress.length() == 0) {
        return false;
    }
    address = ipAddress;
    return true;
}

bool FakeMachine::environment(const char* name, ACE_CString& value) const {
    const auto found = env.find(name);
    if (found != env.end()) {
        value = ACE_CString(found->second.data(), found->second.size());
        return true;
    }
    return inheritEnvironment && Machine::environment(name, value);
}

}  // namespace Testing
}  // namespace Quorvex
