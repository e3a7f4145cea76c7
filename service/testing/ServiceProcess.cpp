// Starting and stopping the service executable for tests.
#include "ServiceProcess.h"

#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <fstream>
#include <stdexcept>
#include <thread>

namespace ServiceTesting {
namespace {

constexpr int kStartAttempts = 400;  // of 25 ms: ten seconds
constexpr int kStopAttempts = 400;

std::vector<std::string> commandLine(const ServiceProcess::Settings& settings,
                                     const std::string& binary, const std::string& portFile) {
    std::vector<std::string> args = {binary.empty() ? CONFIGURATION_SERVICE_BINARY : binary};
    args.insert(args.end(), {"--port", "0", "--port-file", portFile, "--store-dir",
                             settings.storeDirectory, "--log-level", "error"});
    if (!settings.hostName.empty()) {
        args.insert(args.end(), {"--host-name", settings.hostName});
    }
    if (!settings.masterAddress.empty()) {
        args.insert(args.end(), {"--master", settings.masterAddress});
    }
    if (!settings.eventDirectory.empty()) {
        args.insert(args.end(), {"--event-dir", settings.eventDirectory});
    }
    args.insert(args.end(), settings.extraArguments.begin(), settings.extraArguments.end());
    return args;
}

int readPort(const std::string& path) {
    std::ifstream in(path);
    int port = 0;
    return (in >> port) ? port : 0;
}

}  // namespace

ServiceProcess::ServiceProcess(const Settings& settings, const std::string& binary)
    : m_portFile(settings.storeDirectory + ".port") {
    ::unlink(m_portFile.c_str());
    const std::vector<std::string> args = commandLine(settings, binary, m_portFile);
    std::vector<char*> argv;
    for (const std::string& arg : args) {
        argv.push_back(const_cast<char*>(arg.c_str()));
    }
    argv.push_back(nullptr);
    m_pid = ::fork();
    if (m_pid < 0) {
        throw std::runtime_error("ServiceProcess: fork failed");
    }
    if (m_pid == 0) {
        ::execv(argv[0], argv.data());
        ::_exit(127);
    }
    for (int i = 0; i < kStartAttempts && m_port == 0; ++i) {
        std::this_thread::sleep_for(std::chrono::milliseconds(25));
        m_port = readPort(m_portFile);
        int status = 0;
        if (m_port == 0 && ::waitpid(m_pid, &status, WNOHANG) == m_pid) {
            m_pid = -1;
            throw std::runtime_error("ServiceProcess: the service exited at start-up");
        }
    }
    if (m_port == 0) {
        stop(SIGKILL);
        throw std::runtime_error("ServiceProcess: the service did not start in time");
    }
}

ServiceProcess::~ServiceProcess() {
    if (m_pid > 0 && stop(SIGTERM) == -1) {
        stop(SIGKILL);
    }
    ::unlink(m_portFile.c_str());
}

std::string ServiceProcess::address() const {
    return "127.0.0.1:" + std::to_string(m_port);
}

int ServiceProcess::stop(int signal) {
    if (m_pid <= 0) {
        return -1;
    }
    ::kill(m_pid, signal);
    for (int i = 0; i < kStopAttempts; ++i) {
        int status = 0;
        if (::waitpid(m_pid, &status, WNOHANG) == m_pid) {
            m_pid = -1;
            return status;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(25));
    }
    return -1;
}

}  // namespace ServiceTesting
