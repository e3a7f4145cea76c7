// ServiceProcess: the real configuration-service executable, started by a test on 127.0.0.1 with
// an ephemeral port, its own store directory, host name, master and event directory. The
// constructor waits (bounded) until the service listens; the destructor stops it with SIGTERM
// (SIGKILL if it does not stop in time). One object per process; not thread-safe.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

namespace ServiceTesting {

class ServiceProcess {
public:
    struct Settings {
        std::string storeDirectory;
        std::string hostName;
        std::string masterAddress;   // empty: a master
        std::string eventDirectory;  // empty: inherited $QUORVEX_EVENT_DIR
        std::vector<std::string> extraArguments;
    };

    // Starts the service (binary: another executable than this build's); throws
    // std::runtime_error when it does not come up in time.
    explicit ServiceProcess(const Settings& settings, const std::string& binary = std::string());
    ~ServiceProcess();
    ServiceProcess(const ServiceProcess&) = delete;
    ServiceProcess& operator=(const ServiceProcess&) = delete;

    int port() const { return m_port; }
    // "127.0.0.1:<port>", the server text for clients.
    std::string address() const;
    pid_t pid() const { return m_pid; }
    // Sends a signal and waits (bounded) for the process to end; returns its wait status, or -1
    // when it did not end in time.
    int stop(int signal);

private:
    pid_t m_pid = -1;
    int m_port = 0;
    std::string m_portFile;
};

}  // namespace ServiceTesting
