// The real Linux machine, and the switch that lets tests install another.
#include "Quorvex/Machine.h"

#include <arpa/inet.h>
#include <ifaddrs.h>
#include <netdb.h>
#include <netinet/in.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <chrono>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <utility>

namespace Quorvex {
namespace {

const Machine& realMachine() {
    static const Machine machine;
    return machine;
}

std::atomic<const Machine*>& current() {
    static std::atomic<const Machine*> machine{nullptr};
    return machine;
}

ACE_CString canonicalName(const char* shortName) {
    addrinfo hints{};
    hints.ai_family = AF_UNSPEC;
    hints.ai_flags = AI_CANONNAME;
    addrinfo* info = nullptr;
    if (getaddrinfo(shortName, nullptr, &hints, &info) != 0 || info == nullptr) {
        return shortName;
    }
    ACE_CString name = info->ai_canonname != nullptr ? info->ai_canonname : shortName;
    freeaddrinfo(info);
    return name;
}

// path under root, with one slash between them.
std::string underRoot(const std::string& root, const char* path) {
    if (!root.empty() && root.back() == '/') {
        return root + path;
    }
    return root + "/" + path;
}

bool isFile(const std::string& path) {
    struct stat info {};
    return stat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode);
}

}  // namespace

// The cluster stack's own configuration and the cluster information base it keeps once a cluster
// has been formed; either shows that this machine was set up as a node.
const char* const Machine::CLUSTER_CONFIGURATION_FILES[2] = {"etc/corosync/corosync.conf",
                                                             "var/lib/pacemaker/cib/cib.xml"};

Machine::Machine(std::string systemRoot) : m_systemRoot(std::move(systemRoot)) {}

ACE_CString Machine::hostName(bool fullyQualified) const {
    char buf[HOST_NAME_MAX + 1] = {};
    if (gethostname(buf, sizeof buf - 1) != 0 || buf[0] == '\0') {
        return ACE_CString();
    }
    if (fullyQualified) {
        return canonicalName(buf);
    }
    if (char* dot = std::strchr(buf, '.')) {
        *dot = '\0';
    }
    return ACE_CString(buf);
}

bool Machine::localIPAddress(ACE_CString& address) const {
    ifaddrs* list = nullptr;
    if (getifaddrs(&list) != 0) {
        return false;
    }
    bool found = false;
    for (ifaddrs* it = list; it != nullptr && !found; it = it->ifa_next) {
        if (it->ifa_addr == nullptr || it->ifa_addr->sa_family != AF_INET) {
            continue;
        }
        const auto* in = reinterpret_cast<const sockaddr_in*>(it->ifa_addr);
        if ((ntohl(in->sin_addr.s_addr) >> 24) == 127) {
            continue;
        }
        char text[INET_ADDRSTRLEN] = {};
        if (inet_ntop(AF_INET, &in->sin_addr, text, sizeof text) != nullptr) {
            address = text;
            found = true;
        }
    }
    freeifaddrs(list);
    return found;
}

std::vector<ACE_CString> Machine::logicalDrives() const {
    return {};
}

ACE_CString Machine::executablePath() const {
    char buf[PATH_MAX + 1] = {};
    const ssize_t n = readlink("/proc/self/exe", buf, PATH_MAX);
    return n > 0 ? ACE_CString(buf, static_cast<ACE_CString::size_type>(n)) : ACE_CString();
}

bool Machine::isClusterNode() const {
    ACE_CString overridden;
    if (environment(CLUSTER_NODE_VARIABLE, overridden) &&
        (overridden == "1" || overridden == "0")) {
        return overridden == "1";
    }
    for (const char* file : CLUSTER_CONFIGURATION_FILES) {
        if (isFile(underRoot(m_systemRoot, file))) {
            return true;
        }
    }
    return false;
}

bool Machine::environment(const char* name, ACE_CString& value) const {
    const char* v = std::getenv(name);
    if (v == nullptr) {
        return false;
    }
    value = v;
    return true;
}

std::int64_t Machine::nowMilliseconds() const {
    using namespace std::chrono;
    return duration_cast<milliseconds>(system_clock::now().time_since_epoch()).count();
}

const Machine& CurrentMachine() {
    const Machine* m = current().load(std::memory_order_acquire);
    return m != nullptr ? *m : realMachine();
}

ScopedMachine::ScopedMachine(const Machine& machine)
    : m_previous(current().exchange(&machine, std::memory_order_acq_rel)) {}

ScopedMachine::~ScopedMachine() {
    current().store(m_previous, std::memory_order_release);
}

}  // namespace Quorvex
