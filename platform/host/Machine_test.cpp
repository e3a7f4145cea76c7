// The real machine's cluster-node answer, with its system files under a scratch root and its
// environment given by the test.
#include "Quorvex/Machine.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <fstream>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "Quorvex/Host.h"
#include "testing/ScratchDir.h"

namespace {

using Quorvex::Machine;
using Quorvex::Testing::ScratchDir;

// The real Linux machine, but rooted in a scratch folder and with only the given environment.
class RootedMachine : public Machine {
public:
    RootedMachine(const std::string& root, std::map<std::string, std::string> env)
        : Machine(root), m_env(std::move(env)) {}

    bool environment(const char* name, ACE_CString& value) const override {
        const auto found = m_env.find(name);
        if (found == m_env.end()) {
            return false;
        }
        value = found->second.c_str();
        return true;
    }

private:
    std::map<std::string, std::string> m_env;
};

// Creates root/relative with its folders; a name ending in '/' becomes a folder.
void create(const std::string& root, const std::string& relative) {
    std::string path = root;
    std::size_t start = 0;
    for (std::size_t slash; (slash = relative.find('/', start)) != std::string::npos;
         start = slash + 1) {
        path += "/" + relative.substr(start, slash - start);
        mkdir(path.c_str(), 0755);
    }
    if (start < relative.size()) {
        std::ofstream(path + "/" + relative.substr(start)) << "totem {}\n";
    }
}

struct ClusterCase {
    std::vector<std::string> files;
    const char* variable;  // QUORVEX_CLUSTER_NODE, or nullptr when unset
    bool node;
};

TEST(MachineCluster, ANodeIsAMachineWithAConfiguredClusterStackUnlessOverridden) {
    const std::string corosync = "etc/corosync/corosync.conf";
    const std::string cib = "var/lib/pacemaker/cib/cib.xml";
    const ClusterCase cases[] = {
        {{}, nullptr, false},
        {{corosync}, nullptr, true},
        {{cib}, nullptr, true},
        {{corosync, cib}, nullptr, true},
        {{"etc/corosync/corosync.conf/"}, nullptr, false},  // a folder is no configuration
        {{"etc/corosync/corosync.conf.example"}, nullptr, false},
        {{"etc/corosync/"}, nullptr, false},
        {{corosync}, "0", false},
        {{}, "1", true},
        {{corosync}, "1", true},
        {{}, "yes", false},  // only "1" and "0" override
        {{cib}, "", true},
    };
    for (const ClusterCase& c : cases) {
        ScratchDir root;
        for (const std::string& file : c.files) {
            create(root.path(), file);
        }
        std::map<std::string, std::string> env;
        if (c.variable != nullptr) {
            env[Machine::CLUSTER_NODE_VARIABLE] = c.variable;
        }
        const RootedMachine machine(root.path(), env);
        EXPECT_EQ(c.node, machine.isClusterNode())
            << (c.files.empty() ? "no files" : c.files.front()) << ", variable "
            << (c.variable != nullptr ? c.variable : "unset");
        const RootedMachine slashed(root.path() + "/", env);
        EXPECT_EQ(c.node, slashed.isClusterNode()) << "root with a trailing slash";
    }
}

TEST(MachineCluster, HostAnswersFromTheCurrentMachine) {
    ScratchDir root;
    create(root.path(), "var/lib/pacemaker/cib/cib.xml");
    const RootedMachine node(root.path(), {});
    const Quorvex::ScopedMachine scope(node);
    EXPECT_TRUE(Quorvex::IsClusterNode());
}

}  // namespace
