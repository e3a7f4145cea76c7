// FakeMachine: a Quorvex::Machine whose every fact a test sets, with a clock that only moves when
// the test advances it. Install it with Quorvex::ScopedMachine. Not thread-safe to change while
// other threads read it, except the clock, which is atomic.
#pragma once

#include <atomic>
#include <map>
#include <string>

#include "Quorvex/Machine.h"

namespace Quorvex {
namespace Testing {

class FakeMachine : public Machine {
public:
    FakeMachine();

    ACE_CString hostName(bool fullyQualified) const override;
    bool localIPAddress(ACE_CString& address) const override;
    std::vector<ACE_CString> logicalDrives() const override { return drives; }
    ACE_CString executablePath() const override { return executable; }
    bool isClusterNode() const override { return clusterNode; }
    bool environment(const char* name, ACE_CString& value) const override;
    std::int64_t nowMilliseconds() const override { return m_now.load(); }

    // Moves the clock.
    void advanceMilliseconds(std::int64_t ms) { m_now += ms; }
    void setNowMilliseconds(std::int64_t ms) { m_now = ms; }

    ACE_CString shortName = "testhost";
    ACE_CString domain = "example.test";
    ACE_CString ipAddress = "192.0.2.10";  // empty: no address
    std::vector<ACE_CString> drives;
    ACE_CString executable = "C:\\Program Files\\Quorvex\\bin\\server.exe";
    bool clusterNode = false;
    std::map<std::string, std::string> env;  // consulted first
    bool inheritEnvironment = true;          // then the real environment

private:
    std::atomic<std::int64_t> m_now;
};

}  // namespace Testing
}  // namespace Quorvex
