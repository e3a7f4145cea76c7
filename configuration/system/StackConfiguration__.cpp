#include "Configuration/StackConfiguration__.h"

#include <vector>

#include "Quorvex/Host.h"
#include "Quorvex/Paths.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

const char kInputFolder[] = "Quorvex\\input\\";
const char kStackFolder[] = "Quorvex\\stack\\";
const char kMountPointFolder[] = "Quorvex\\MultiStack\\";
// The shared disk of a failover cluster.
const char kClusterDrive[] = "I:\\";

// The drive that holds the machine's data: the second of several drives, the only drive, or
// fallback when the machine reports none.
ACE_CString dataDrive(const std::vector<ACE_CString>& drives, const char* fallback) {
    if (drives.empty()) {
        return ACE_CString(fallback);
    }
    return drives.size() == 1 ? drives[0] : drives[1];
}

ACE_CString defaultInputDirectory(const std::vector<ACE_CString>& drives) {
    const ACE_CString drive =
        Quorvex::IsClusterNode() ? ACE_CString(kClusterDrive) : dataDrive(drives, "C:\\");
    return drive + kInputFolder;
}

// The folder holding the stack folder, with a trailing separator.
ACE_CString defaultConfigBackupDirectory(const std::vector<ACE_CString>& drives) {
    const ACE_CString stackFolder = dataDrive(drives, "c:\\") + kStackFolder;
    return Quorvex::getAllButLastPathElement(stackFolder) + "\\";
}

ACE_CString defaultMountPointRoot() {
    const ACE_CString drive = Quorvex::getDriveElement(Quorvex::GetExecutablePath());
    return Quorvex::normalizePath(Quorvex::concatPath(drive, kMountPointFolder));
}

}  // namespace

template <class Self, class Io>
void StackConfiguration__::fields(Self& self, Io& io) {
    io("DICOMInputDirectory", self.m_dicomInputDirectory);
    io("ConfigBackupDirectoryName", self.m_configBackupDirectoryName);
    io("ReconstructDirectoryName", self.m_reconstructDirectoryName);
    io("MountPointRootDirectory", self.m_mountPointRootDirectory);
    io("ReconstructDirectoryNeedsRebuild", self.m_needsRebuild);
    io("ReconstructDirectoryNeedsReregistration", self.m_needsReregistration);
    io("ReconstructDirectoryNeedsInternalReregistration", self.m_needsInternalReregistration);
    io("ReconstructDirectoryNeedsMigration", self.m_needsMigration);
    io("ReconstructDirectoryNeedsReArchive", self.m_needsReArchive);
    io("ReconstructMigrationTarget", self.m_migrationTarget);
    io("ReconstructMigrationOtherTargetName", self.m_migrationOtherTargetName);
    io("ReconstructReregistrationQueue", self.m_reregistrationQueue);
    io("ReconstructReregistrationOtherQueueName", self.m_reregistrationOtherQueueName);
    io("VolDiscoveryMode", self.m_volDiscoveryMode);
}

CONFIGURATION_DEFINE(StackConfiguration__, "Stack", Fields::FailureForm::PartialDefaults)

StackConfiguration__::StackConfiguration__() {
    const std::vector<ACE_CString> drives = Quorvex::GetLogicalDriveList();
    m_dicomInputDirectory = defaultInputDirectory(drives);
    m_configBackupDirectoryName = defaultConfigBackupDirectory(drives);
    m_mountPointRootDirectory = defaultMountPointRoot();
}

}  // namespace Configuration
