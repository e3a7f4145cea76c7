// configuration-service: one per-machine configuration service in the foreground.
#include <ace/Log_Msg.h>
#include <malloc.h>
#include <pthread.h>
#include <signal.h>
#include <sys/resource.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <thread>

#include "ConfigurationServer.h"
#include "Quorvex/Log.h"
#include "TicketCheck.h"

namespace {

using ConfigurationService::ConfigurationServer;
using ConfigurationService::ServiceOptions;

constexpr int kLargestHeapBlock = 32 << 20;  // larger blocks are mapped (the allocator's maximum)
constexpr int kHeapSlack = 128 << 20;        // free memory an arena keeps before it shrinks
constexpr int kArenas = 1;                   // every thread allocates from the main heap

void setLogLevel(const std::string& level) {
    u_long mask = LM_ERROR | LM_CRITICAL | LM_ALERT | LM_EMERGENCY;
    if (level != "error") {
        mask |= LM_WARNING;
    }
    if (level == "info" || level == "debug") {
        mask |= LM_INFO | LM_NOTICE;
    }
    if (level == "debug") {
        mask |= LM_DEBUG;
    }
    ACE_LOG_MSG->priority_mask(mask, ACE_Log_Msg::PROCESS);
}

// Writes the port through a temporary file, so a reader never sees half of it.
void writePortFile(const std::string& path, int port) {
    const std::string temp = path + ".tmp";
    std::ofstream(temp) << port << "\n";
    if (std::rename(temp.c_str(), path.c_str()) != 0) {
        throw std::runtime_error("cannot write the port file " + path);
    }
}

// Process settings for many connections and large requests: as many descriptors as allowed, and
// an allocator that keeps large blocks (request bodies, answers up to tens of MiB) in its heap
// and does not shrink the heap on every free. Mapping, unmapping and trimming each answer made
// every large request fault its pages in afresh, and the faults and TLB shoot-downs across the
// socket threads cost more than building the answer. The HTTP front trims once large traffic
// pauses (MemoryTrimmer); one arena, because a trim returns the top of the main heap only: a
// second arena kept its top (8 MiB) after a burst of 1 MiB retrieves, at no gain in speed.
void prepareProcess() {
    rlimit files{};
    if (::getrlimit(RLIMIT_NOFILE, &files) == 0 && files.rlim_cur < files.rlim_max) {
        files.rlim_cur = files.rlim_max;
        ::setrlimit(RLIMIT_NOFILE, &files);
    }
    ::mallopt(M_MMAP_THRESHOLD, kLargestHeapBlock);
    ::mallopt(M_TRIM_THRESHOLD, kHeapSlack);
    ::mallopt(M_ARENA_MAX, kArenas);
}

int serve(const ServiceOptions& options, const sigset_t& stopSignals) {
    if (!options.eventDirectory.empty()) {
        ::setenv("QUORVEX_EVENT_DIR", options.eventDirectory.c_str(), 1);
    }
    ConfigurationServer server(options, ConfigurationService::TicketCheck::machineTicket());
    if (!options.portFile.empty()) {
        writePortFile(options.portFile, server.port());
    }
    QUORVEX_LOG(LM_INFO, "configuration-service: listening on %s:%d, store %s\n",
                options.bindAddress.c_str(), server.port(), options.storeDirectory.c_str());
    std::thread watcher([&server, &stopSignals] {
        int received = 0;
        sigwait(&stopSignals, &received);
        QUORVEX_LOG(LM_INFO, "configuration-service: signal %d, stopping\n", received);
        server.stop();
    });
    const bool ok = server.run();
    pthread_kill(watcher.native_handle(), SIGTERM);  // wakes the watcher if run() ended alone
    watcher.join();
    QUORVEX_LOG(LM_INFO, "configuration-service: stopped\n");
    return ok ? 0 : 1;
}

}  // namespace

int main(int argc, char** argv) {
    const std::string program = "configuration-service";
    ServiceOptions options;
    try {
        options = ServiceOptions::parse(std::vector<std::string>(argv + 1, argv + argc));
    } catch (const std::exception& e) {
        std::cerr << program << ": " << e.what() << "\n";
        return 2;
    }
    if (options.help) {
        std::cout << ServiceOptions::usage(program);
        return 0;
    }
    setLogLevel(options.logLevel);
    prepareProcess();
    // Every thread inherits the blocked stop signals; only the watcher receives them.
    sigset_t stopSignals;
    sigemptyset(&stopSignals);
    sigaddset(&stopSignals, SIGINT);
    sigaddset(&stopSignals, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &stopSignals, nullptr);
    signal(SIGPIPE, SIG_IGN);
    try {
        return serve(options, stopSignals);
    } catch (const std::exception& e) {
        std::cerr << program << ": " << e.what() << "\n";
        return 1;
    }
}
