#include "Configuration/StackConfiguration__.h"

#include <gtest/gtest.h>

#include "ElementTestSupport.h"
#include "testing/FakeMachine.h"

namespace {

using Configuration::StackConfiguration__;
using Quorvex::ScopedMachine;
using Quorvex::Testing::FakeMachine;

struct Directories {
    std::string input;
    std::string backup;
    std::string mountPoint;
};

Directories defaultsOn(const FakeMachine& machine) {
    ScopedMachine scoped(machine);
    const StackConfiguration__ stack;
    return {stack.getDICOMInputDirectory().c_str(), stack.getConfigBackupDirectoryName().c_str(),
            stack.getMountPointRootDirectory().c_str()};
}

TEST(StackConfigurationDirectories, MachineWithoutDrivesUsesDriveC) {
    FakeMachine machine;
    const Directories dirs = defaultsOn(machine);
    EXPECT_EQ("C:\\Quorvex\\input\\", dirs.input);
    EXPECT_EQ("c:\\Quorvex\\", dirs.backup);
    EXPECT_EQ("C:\\Quorvex\\MultiStack\\", dirs.mountPoint);
}

TEST(StackConfigurationDirectories, SingleDriveHoldsTheData) {
    FakeMachine machine;
    machine.drives = {"E:\\"};
    const Directories dirs = defaultsOn(machine);
    EXPECT_EQ("E:\\Quorvex\\input\\", dirs.input);
    EXPECT_EQ("E:\\Quorvex\\", dirs.backup);
}

TEST(StackConfigurationDirectories, SecondOfSeveralDrivesHoldsTheData) {
    FakeMachine machine;
    machine.drives = {"C:\\", "D:\\", "E:\\"};
    const Directories dirs = defaultsOn(machine);
    EXPECT_EQ("D:\\Quorvex\\input\\", dirs.input);
    EXPECT_EQ("D:\\Quorvex\\", dirs.backup);
}

TEST(StackConfigurationDirectories, ClusterNodeTakesInputFromTheSharedDisk) {
    FakeMachine machine;
    machine.drives = {"C:\\", "D:\\"};
    machine.clusterNode = true;
    const Directories dirs = defaultsOn(machine);
    EXPECT_EQ("I:\\Quorvex\\input\\", dirs.input);
    EXPECT_EQ("D:\\Quorvex\\", dirs.backup);
}

TEST(StackConfigurationDirectories, MountPointFollowsTheExecutablesDrive) {
    FakeMachine machine;
    machine.executable = "E:/Apps//Quorvex/server.exe";
    EXPECT_EQ("E:\\Quorvex\\MultiStack\\", defaultsOn(machine).mountPoint);
    machine.executable = "\\\\store\\apps\\server.exe";
    EXPECT_EQ("\\\\store\\apps\\Quorvex\\MultiStack\\", defaultsOn(machine).mountPoint);
}

TEST(StackConfigurationElement, WritesEveryKeyInOrder) {
    FakeMachine machine;
    ScopedMachine scoped(machine);
    const auto element = StackConfiguration__().writeVesk();
    EXPECT_EQ("Stack", std::string(element->key().c_str()));
    const std::vector<std::string> expected = {"DICOMInputDirectory",
                                               "ConfigBackupDirectoryName",
                                               "ReconstructDirectoryName",
                                               "MountPointRootDirectory",
                                               "ReconstructDirectoryNeedsRebuild",
                                               "ReconstructDirectoryNeedsReregistration",
                                               "ReconstructDirectoryNeedsInternalReregistration",
                                               "ReconstructDirectoryNeedsMigration",
                                               "ReconstructDirectoryNeedsReArchive",
                                               "ReconstructMigrationTarget",
                                               "ReconstructMigrationOtherTargetName",
                                               "ReconstructReregistrationQueue",
                                               "ReconstructReregistrationOtherQueueName",
                                               "VolDiscoveryMode"};
    EXPECT_EQ(expected, Configuration::Testing::childKeys(*element));
    EXPECT_EQ("1", Configuration::Testing::childText(*element, "ReconstructReregistrationQueue"));
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
