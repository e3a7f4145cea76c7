// Configuration::OrvelSystemConfiguration: the per-machine system document "OrvelSystem":
// free-space watermarks, data-protection periods, the machine's storage-stack directories, its
// restart schedule and variation points (three sections), its CORBA endpoints, its log root and the
// name of the master configuration host. The repository reads it when it starts, to learn the
// master.
//
// Keys of element "OrvelSystem" in order, with defaults: "FreespaceWatermark" (u32, 5),
// "WorkstationAutoDeleteEnabled" (flag, true), "WorkstationDataProtectionDays" (u32, 8),
// "FileespaceWatermark" (u32, 3; the doubled "e" is the stored key),
// "FreespaceWatermarkForStackRecycle" (u32, 60), "StudyDateTimeDataProtectionHours" (u32, 24),
// "Stack", "Restart", "VariationPoint" (sections at their defaults), "CORBAEndpoints" (list of
// strings, empty), "LogRoot" (empty), "MasterConfigurationServiceHostName" (empty: this machine is
// its own master), "EnableInversionTesting" (flag, false: a test facility stays off unless asked
// for), "OneTimeInitializationVerified" (flag, false: a fresh machine has not been verified yet),
// "AvailableStoragePortCount" (u32, 1), "NumberOfConsolidationProcesses" (u32, 1),
// "ConsolidationWorkItemDefinition" (i32, 0: the standard work-item definition),
// "AllowEmptyPatientFirstName" (flag, false).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/RestartConfiguration__.h"
#include "Configuration/StackConfiguration__.h"
#include "Configuration/TypedConfigDoc.h"
#include "Configuration/VariationPointConfiguration__.h"

namespace Configuration {

class CONFIGURATION_API OrvelSystemConfiguration : public TypedConfigDoc<OrvelSystemConfiguration> {
    CONFIGURATION_CLASS(OrvelSystemConfiguration);

public:
    // The per-machine document "OrvelSystem" with every key at its default.
    OrvelSystemConfiguration();

    // Free-space watermark of the storage volumes.
    unsigned int getFreespaceWatermark() const { return m_freespaceWatermark; }
    void setFreespaceWatermark(unsigned int value) { m_freespaceWatermark = value; }
    // Whether workstations delete old data automatically.
    bool isWorkstationAutoDeleteEnabled() const { return m_workstationAutoDeleteEnabled; }
    void setWorkstationAutoDeleteEnabled(bool value) { m_workstationAutoDeleteEnabled = value; }
    // Days a workstation keeps data before it may be deleted.
    unsigned int getWorkstationDataProtectionDays() const {
        return m_workstationDataProtectionDays;
    }
    // Keeps days when below 366 and at least 1 (at least 0 while auto-delete is disabled);
    // stores 8 otherwise.
    void setWorkstationDataProtectionDays(unsigned int days);
    // File-space watermark (stored under the key "FileespaceWatermark").
    unsigned int getFilespaceWatermark() const { return m_filespaceWatermark; }
    void setFilespaceWatermark(unsigned int value) { m_filespaceWatermark = value; }
    // Free-space watermark below which a stack is recycled.
    unsigned int getFreespaceWatermarkForStackRecycle() const {
        return m_freespaceWatermarkForStackRecycle;
    }
    void setFreespaceWatermarkForStackRecycle(unsigned int value) {
        m_freespaceWatermarkForStackRecycle = value;
    }
    // Hours a study is protected after its study date and time.
    unsigned int getStudyDateTimeDataProtectionHours() const {
        return m_studyDateTimeDataProtectionHours;
    }
    // Keeps hours from 1 to 360; stores 24 otherwise.
    void setStudyDateTimeDataProtectionHours(unsigned int hours);

    // The storage-stack section.
    const StackConfiguration__& getStack() const { return m_stack; }
    void setStack(const StackConfiguration__& value) { m_stack = value; }
    // The restart-schedule section.
    const RestartConfiguration__& getRestart() const { return m_restart; }
    void setRestart(const RestartConfiguration__& value) { m_restart = value; }
    // The variation-point section.
    const VariationPointConfiguration__& getVariationPoint() const { return m_variationPoint; }
    void setVariationPoint(const VariationPointConfiguration__& value) { m_variationPoint = value; }

    // CORBA endpoints of the machine's servers, in order.
    const std::vector<ACE_CString>& getCORBAEndpoints() const { return m_corbaEndpoints; }
    void setCORBAEndpoints(const std::vector<ACE_CString>& value) { m_corbaEndpoints = value; }
    // Root folder of the log files.
    const ACE_CString& getLogRoot() const { return m_logRoot; }
    void setLogRoot(const ACE_CString& value) { m_logRoot = value; }
    // Host of the master configuration service; empty when this machine is its own master.
    const ACE_CString& getMasterConfigurationServiceHostName() const {
        return m_masterConfigurationServiceHostName;
    }
    void setMasterConfigurationServiceHostName(const ACE_CString& value) {
        m_masterConfigurationServiceHostName = value;
    }
    // Whether inversion testing is enabled.
    bool isEnableInversionTesting() const { return m_enableInversionTesting; }
    void setEnableInversionTesting(bool value) { m_enableInversionTesting = value; }
    // Whether the machine's one-time initialisation has been verified.
    bool isOneTimeInitializationVerified() const { return m_oneTimeInitializationVerified; }
    void setOneTimeInitializationVerified(bool value) { m_oneTimeInitializationVerified = value; }
    // Number of storage ports the machine offers.
    unsigned int getAvailableStoragePortCount() const { return m_availableStoragePortCount; }
    void setAvailableStoragePortCount(unsigned int value) { m_availableStoragePortCount = value; }
    // Number of consolidation processes the machine runs.
    unsigned int getNumberOfConsolidationProcesses() const {
        return m_numberOfConsolidationProcesses;
    }
    void setNumberOfConsolidationProcesses(unsigned int value) {
        m_numberOfConsolidationProcesses = value;
    }
    // Which definition of a consolidation work item is used.
    int getConsolidationWorkItemDefinition() const { return m_consolidationWorkItemDefinition; }
    void setConsolidationWorkItemDefinition(int value) {
        m_consolidationWorkItemDefinition = value;
    }
    // Whether a patient may be stored without a first name.
    bool isAllowEmptyPatientFirstName() const { return m_allowEmptyPatientFirstName; }
    void setAllowEmptyPatientFirstName(bool value) { m_allowEmptyPatientFirstName = value; }

private:
    static constexpr unsigned int kDefaultWorkstationDataProtectionDays = 8;
    static constexpr unsigned int kDefaultStudyDateTimeDataProtectionHours = 24;

    unsigned int m_freespaceWatermark = 5;
    bool m_workstationAutoDeleteEnabled = true;
    unsigned int m_workstationDataProtectionDays = kDefaultWorkstationDataProtectionDays;
    unsigned int m_filespaceWatermark = 3;
    unsigned int m_freespaceWatermarkForStackRecycle = 60;
    unsigned int m_studyDateTimeDataProtectionHours = kDefaultStudyDateTimeDataProtectionHours;
    StackConfiguration__ m_stack;
    RestartConfiguration__ m_restart;
    VariationPointConfiguration__ m_variationPoint;
    std::vector<ACE_CString> m_corbaEndpoints;
    ACE_CString m_logRoot;
    ACE_CString m_masterConfigurationServiceHostName;
    bool m_enableInversionTesting = false;
    bool m_oneTimeInitializationVerified = false;
    unsigned int m_availableStoragePortCount = 1;
    unsigned int m_numberOfConsolidationProcesses = 1;
    int m_consolidationWorkItemDefinition = 0;
    bool m_allowEmptyPatientFirstName = false;
};

}  // namespace Configuration
