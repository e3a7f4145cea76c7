#include "Configuration/OrvelSystemConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

// Longest study-date protection, in hours (15 days).
constexpr unsigned int kMaxStudyDateTimeDataProtectionHours = 360;
// Workstation protection must stay below a year.
constexpr unsigned int kWorkstationDataProtectionDaysLimit = 366;

}  // namespace

template <class Self, class Io>
void OrvelSystemConfiguration::fields(Self& self, Io& io) {
    io("FreespaceWatermark", self.m_freespaceWatermark);
    io("WorkstationAutoDeleteEnabled", self.m_workstationAutoDeleteEnabled);
    io("WorkstationDataProtectionDays", self.m_workstationDataProtectionDays);
    io("FileespaceWatermark", self.m_filespaceWatermark);
    io("FreespaceWatermarkForStackRecycle", self.m_freespaceWatermarkForStackRecycle);
    io("StudyDateTimeDataProtectionHours", self.m_studyDateTimeDataProtectionHours);
    io("Stack", self.m_stack);
    io("Restart", self.m_restart);
    io("VariationPoint", self.m_variationPoint);
    io("CORBAEndpoints", self.m_corbaEndpoints);
    io("LogRoot", self.m_logRoot);
    io("MasterConfigurationServiceHostName", self.m_masterConfigurationServiceHostName);
    io("EnableInversionTesting", self.m_enableInversionTesting);
    io("OneTimeInitializationVerified", self.m_oneTimeInitializationVerified);
    io("AvailableStoragePortCount", self.m_availableStoragePortCount);
    io("NumberOfConsolidationProcesses", self.m_numberOfConsolidationProcesses);
    io("ConsolidationWorkItemDefinition", self.m_consolidationWorkItemDefinition);
    io("AllowEmptyPatientFirstName", self.m_allowEmptyPatientFirstName);
}

CONFIGURATION_DEFINE(OrvelSystemConfiguration, "OrvelSystem", Fields::FailureForm::PartialDefaults)

OrvelSystemConfiguration::OrvelSystemConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kOrvelSystem,
                     true) {}

void OrvelSystemConfiguration::setWorkstationDataProtectionDays(unsigned int days) {
    const unsigned int minimum = m_workstationAutoDeleteEnabled ? 1 : 0;
    const bool valid = days >= minimum && days < kWorkstationDataProtectionDaysLimit;
    m_workstationDataProtectionDays = valid ? days : kDefaultWorkstationDataProtectionDays;
}

void OrvelSystemConfiguration::setStudyDateTimeDataProtectionHours(unsigned int hours) {
    const bool valid = hours >= 1 && hours <= kMaxStudyDateTimeDataProtectionHours;
    m_studyDateTimeDataProtectionHours = valid ? hours : kDefaultStudyDateTimeDataProtectionHours;
}

}  // namespace Configuration
