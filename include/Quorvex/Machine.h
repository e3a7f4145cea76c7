// Quorvex::Machine: every fact the library asks of the machine it runs on, behind one interface,
// so that a test can be a machine with drives C: and D:, a cluster node, or five minutes later.
//
// CurrentMachine() is the real Linux machine unless a test installed another with ScopedMachine.
// Installing is not thread-safe (do it before starting threads); using the current machine is.
//
// Cluster node on Linux: QUORVEX_CLUSTER_NODE set to "1" or "0" decides; otherwise the machine is
// a node when a cluster stack is configured on it, that is when /etc/corosync/corosync.conf or
// /var/lib/pacemaker/cib/cib.xml is a file. A Machine made with another system root looks for
// those files under it instead of "/" (tests).
#pragma once

#include <ace/SString.h>

#include <cstdint>
#include <string>
#include <vector>

namespace Quorvex {

class Machine {
public:
    // Environment variable that overrides cluster-node detection: "1" a node, "0" not a node.
    static constexpr const char* CLUSTER_NODE_VARIABLE = "QUORVEX_CLUSTER_NODE";
    // Files whose presence, relative to the system root, shows a configured cluster stack.
    static const char* const CLUSTER_CONFIGURATION_FILES[2];

    // The machine whose system files lie under systemRoot ("/": this machine's own).
    explicit Machine(std::string systemRoot = "/");
    virtual ~Machine() = default;
    // This machine's host name: the short one, or the fully qualified one; empty on failure.
    virtual ACE_CString hostName(bool fullyQualified) const;
    // The first non-loopback IPv4 address in dotted form; false when there is none.
    virtual bool localIPAddress(ACE_CString& address) const;
    // Logical drives such as "C:\" (a Linux machine has none).
    virtual std::vector<ACE_CString> logicalDrives() const;
    // The full path of the running executable.
    virtual ACE_CString executablePath() const;
    // Whether this machine is a node of a failover cluster: the override variable when it is "1"
    // or "0", else whether one of the cluster configuration files exists as a file.
    virtual bool isClusterNode() const;
    // The value of an environment variable; false when it is not set.
    virtual bool environment(const char* name, ACE_CString& value) const;
    // The current time, UTC milliseconds since 1970-01-01.
    virtual std::int64_t nowMilliseconds() const;

private:
    std::string m_systemRoot;
};

// The machine in effect: the real one, or the one a ScopedMachine installed.
const Machine& CurrentMachine();

// Installs a replacement machine for its lifetime (tests). Nests; not thread-safe to construct.
class ScopedMachine {
public:
    explicit ScopedMachine(const Machine& machine);
    ~ScopedMachine();
    ScopedMachine(const ScopedMachine&) = delete;
    ScopedMachine& operator=(const ScopedMachine&) = delete;

private:
    const Machine* m_previous;
};

}  // namespace Quorvex
