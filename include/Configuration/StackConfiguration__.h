// Configuration::StackConfiguration__: the storage-stack section ("Stack") of the per-machine
// system document: where DICOM input arrives, where configuration backups and reconstructions
// live, where stack volumes are mounted, and what a pending reconstruction still has to do.
//
// Keys in order, with defaults: "DICOMInputDirectory" (the data drive + "Quorvex\input\"; the
// data drive is the second of several drives, the only one, or "C:\" when the machine reports
// none; "I:\" on a cluster node, the shared cluster disk), "ConfigBackupDirectoryName" (the folder
// holding the stack folder, with a trailing "\": the data drive chosen by the same rule, "c:\"
// without drives, + "Quorvex\"), "ReconstructDirectoryName" (empty), "MountPointRootDirectory" (the
// executable's drive + "Quorvex\MultiStack\", normalised), five "ReconstructDirectoryNeeds..."
// flags (false), "ReconstructMigrationTarget" (0), "ReconstructMigrationOtherTargetName" (empty),
// "ReconstructReregistrationQueue" (1), "ReconstructReregistrationOtherQueueName" (empty),
// "VolDiscoveryMode" (0).
// Plain value owned by its caller; not thread-safe. The constructor asks the current machine
// (Quorvex::CurrentMachine) for its drives, executable and cluster membership.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API StackConfiguration__ : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(StackConfiguration__);

public:
    // Every key at its default; the directories come from this machine's drives.
    StackConfiguration__();

    // Folder where incoming DICOM files are dropped.
    const ACE_CString& getDICOMInputDirectory() const { return m_dicomInputDirectory; }
    void setDICOMInputDirectory(const ACE_CString& value) { m_dicomInputDirectory = value; }
    // Folder that receives configuration backups.
    const ACE_CString& getConfigBackupDirectoryName() const { return m_configBackupDirectoryName; }
    void setConfigBackupDirectoryName(const ACE_CString& value) {
        m_configBackupDirectoryName = value;
    }
    // Folder of a stack being reconstructed; empty when none is.
    const ACE_CString& getReconstructDirectoryName() const { return m_reconstructDirectoryName; }
    void setReconstructDirectoryName(const ACE_CString& value) {
        m_reconstructDirectoryName = value;
    }
    // Root under which stack volumes are mounted.
    const ACE_CString& getMountPointRootDirectory() const { return m_mountPointRootDirectory; }
    void setMountPointRootDirectory(const ACE_CString& value) { m_mountPointRootDirectory = value; }
    // Whether the reconstructed stack must be rebuilt.
    bool isReconstructDirectoryNeedsRebuild() const { return m_needsRebuild; }
    void setReconstructDirectoryNeedsRebuild(bool value) { m_needsRebuild = value; }
    // Whether the reconstructed stack must be registered again.
    bool isReconstructDirectoryNeedsReregistration() const { return m_needsReregistration; }
    void setReconstructDirectoryNeedsReregistration(bool value) { m_needsReregistration = value; }
    // Whether the reconstructed stack must be registered again internally.
    bool isReconstructDirectoryNeedsInternalReregistration() const {
        return m_needsInternalReregistration;
    }
    void setReconstructDirectoryNeedsInternalReregistration(bool value) {
        m_needsInternalReregistration = value;
    }
    // Whether the reconstructed stack must be migrated.
    bool isReconstructDirectoryNeedsMigration() const { return m_needsMigration; }
    void setReconstructDirectoryNeedsMigration(bool value) { m_needsMigration = value; }
    // Whether the reconstructed stack must be archived again.
    bool isReconstructDirectoryNeedsReArchive() const { return m_needsReArchive; }
    void setReconstructDirectoryNeedsReArchive(bool value) { m_needsReArchive = value; }
    // Target of the reconstruction's migration.
    unsigned short getReconstructMigrationTarget() const { return m_migrationTarget; }
    void setReconstructMigrationTarget(unsigned short value) { m_migrationTarget = value; }
    // Name of the migration target when it is not one of the standard ones.
    const ACE_CString& getReconstructMigrationOtherTargetName() const {
        return m_migrationOtherTargetName;
    }
    void setReconstructMigrationOtherTargetName(const ACE_CString& value) {
        m_migrationOtherTargetName = value;
    }
    // Queue that receives the reconstruction's re-registrations.
    unsigned short getReconstructReregistrationQueue() const { return m_reregistrationQueue; }
    void setReconstructReregistrationQueue(unsigned short value) { m_reregistrationQueue = value; }
    // Name of the re-registration queue when it is not one of the standard ones.
    const ACE_CString& getReconstructReregistrationOtherQueueName() const {
        return m_reregistrationOtherQueueName;
    }
    void setReconstructReregistrationOtherQueueName(const ACE_CString& value) {
        m_reregistrationOtherQueueName = value;
    }
    // How stack volumes are discovered.
    unsigned int getVolDiscoveryMode() const { return m_volDiscoveryMode; }
    void setVolDiscoveryMode(unsigned int value) { m_volDiscoveryMode = value; }

private:
    ACE_CString m_dicomInputDirectory;
    ACE_CString m_configBackupDirectoryName;
    ACE_CString m_reconstructDirectoryName;
    ACE_CString m_mountPointRootDirectory;
    bool m_needsRebuild = false;
    bool m_needsReregistration = false;
    bool m_needsInternalReregistration = false;
    bool m_needsMigration = false;
    bool m_needsReArchive = false;
    unsigned short m_migrationTarget = 0;
    ACE_CString m_migrationOtherTargetName;
    unsigned short m_reregistrationQueue = 1;
    ACE_CString m_reregistrationOtherQueueName;
    unsigned int m_volDiscoveryMode = 0;
};

}  // namespace Configuration
