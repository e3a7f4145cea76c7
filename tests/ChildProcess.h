// ChildProcess: runs a program with extra environment variables and collects its standard
// output, for tests that need a second process. The constructor starts it; lines are read with a
// bounded wait; the destructor kills it if it still runs. Not thread-safe.
#pragma once

#include <sys/types.h>

#include <map>
#include <string>
#include <vector>

namespace IntegrationTesting {

class ChildProcess {
public:
    ChildProcess(const std::vector<std::string>& args,
                 const std::map<std::string, std::string>& environment);
    ~ChildProcess();
    ChildProcess(const ChildProcess&) = delete;
    ChildProcess& operator=(const ChildProcess&) = delete;

    // The next line of output (without its newline); empty when none came within timeoutMs.
    std::string readLine(int timeoutMs);
    // Waits up to timeoutMs for the exit; the exit code, or -1 when it did not end in time.
    int wait(int timeoutMs);

private:
    pid_t m_pid = -1;
    int m_out = -1;
    std::string m_buffer;
};

}  // namespace IntegrationTesting
