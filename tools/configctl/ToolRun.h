// Test support for configctl's tests: runs a command line (or configctl itself, CONFIGCTL_BINARY)
// in a shell and collects what it prints, stderr joined to stdout, and its exit status.
#pragma once

#include <sys/wait.h>

#include <cstdio>
#include <string>

namespace Configctl {
namespace Testing {

struct ToolRun {
    int status;       // the exit status; -1 when the command did not exit normally
    std::string out;  // stdout and stderr together
};

// Runs a shell command line; stderr joins stdout.
inline ToolRun shell(const std::string& commandLine) {
    const std::string command = commandLine + " 2>&1";
    FILE* pipe = ::popen(command.c_str(), "r");
    ToolRun run{-1, ""};
    if (pipe == nullptr) {
        return run;
    }
    char buffer[4096];
    for (std::size_t got; (got = std::fread(buffer, 1, sizeof buffer, pipe)) > 0;) {
        run.out.append(buffer, got);
    }
    const int status = ::pclose(pipe);
    run.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return run;
}

// Runs configctl with arguments (shell-quoted by the caller).
inline ToolRun configctl(const std::string& arguments) {
    return shell(std::string(CONFIGCTL_BINARY) + " " + arguments);
}

}  // namespace Testing
}  // namespace Configctl
