#include "Configuration/StackConfiguration__.h"

#include <gtest/gtest.h>

#include "testing/FakeMachine.h"

namespace {

using Configuration::StackConfiguration__;
using Quorvex::ScopedMachine;
using Quorvex::Testing::FakeMachine;

struct DirectoryCase {
    std::vector<ACE_CString> drives;
    bool clusterNode;
    const char* input;
    const char* backup;
};

// The data drive is C: without drives, the only drive, else the second; a cluster node takes its
// input from the shared disk I:.
TEST(StackConfigurationDirectories, DefaultsFollowTheMachinesDrives) {
    const DirectoryCase cases[] = {
        {{}, false, "C:\\Quorvex\\input\\", "c:\\Quorvex\\"},
        {{"E:\\"}, false, "E:\\Quorvex\\input\\", "E:\\Quorvex\\"},
        {{"C:\\", "D:\\", "E:\\"}, false, "D:\\Quorvex\\input\\", "D:\\Quorvex\\"},
        {{"C:\\", "D:\\"}, true, "I:\\Quorvex\\input\\", "D:\\Quorvex\\"}};
    for (const DirectoryCase& c : cases) {
        FakeMachine machine;
        machine.drives = c.drives;
        machine.clusterNode = c.clusterNode;
        ScopedMachine scoped(machine);
        const StackConfiguration__ stack;
        EXPECT_STREQ(c.input, stack.getDICOMInputDirectory().c_str());
        EXPECT_STREQ(c.backup, stack.getConfigBackupDirectoryName().c_str());
        EXPECT_STREQ("C:\\Quorvex\\MultiStack\\", stack.getMountPointRootDirectory().c_str());
    }
}

std::string mountPointOn(const FakeMachine& machine) {
    ScopedMachine scoped(machine);
    return StackConfiguration__().getMountPointRootDirectory().c_str();
}

TEST(StackConfigurationDirectories, MountPointFollowsTheExecutablesDrive) {
    FakeMachine machine;
    machine.executable = "E:/Apps//Quorvex/server.exe";
    EXPECT_EQ("E:\\Quorvex\\MultiStack\\", mountPointOn(machine));
    machine.executable = "\\\\store\\apps\\server.exe";
    EXPECT_EQ("\\\\store\\apps\\Quorvex\\MultiStack\\", mountPointOn(machine));
}

// Guards that a stored directory replaces the machine-derived default on reading.
TEST(StackConfigurationElement, StoredDirectoriesWinOverTheMachinesDefaults) {
    StackConfiguration__ stored;
    stored.setDICOMInputDirectory("F:\\incoming\\");
    stored.setReconstructMigrationTarget(65535);
    const auto element = stored.writeVesk();

    FakeMachine machine;
    machine.drives = {"C:\\", "D:\\"};
    ScopedMachine scoped(machine);
    StackConfiguration__ read;
    EXPECT_TRUE(read.readVesk(*element));
    EXPECT_EQ(stored, read);
}

}  // namespace
