// The export module's documents: global settings with their database section, the adapter that
// presents them to older callers, the per-machine settings, the destinations and the web service.
#include "Configuration/DocumentNames.h"
#include "Configuration/KelExportConfigurationAdapter.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "ListReserve.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void KelExportDatabaseConfiguration::fields(Self& self, Io& io) {
    io("Location", self.m_location);
    io("DatabaseName", self.m_databaseName);
    io("ConnectionTimeout", self.m_connectionTimeout);
    io("CommandTimeout", self.m_commandTimeout);
}

CONFIGURATION_DEFINE(KelExportDatabaseConfiguration,
                     KelExportDatabaseConfiguration::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

KelExportDatabaseConfiguration::KelExportDatabaseConfiguration()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kDatabaseConfiguration,
          false) {}

// Read in this order too but for "ServiceStatusReportingFrequency", which reading takes fourth:
// a scalar never ends a read, so the order of the scalars cannot show.
template <class Self, class Io>
void KelExportGlobalConfiguration::fields(Self& self, Io& io) {
    io("CommandStatusLifetime", self.m_commandStatusLifetime);
    io("MaximumNumberOfRetries", self.m_maximumNumberOfRetries);
    io("RetryDelay", self.m_retryDelay);
    io("ExecutionTimeout", self.m_executionTimeout);
    io("LifetimeBeforeArchive", self.m_lifetimeBeforeArchive);
    io("LifetimeInArchiveBeforePurge", self.m_lifetimeInArchive);
    io("PollInterval", self.m_pollInterval);
    io("ServiceStatusReportingFrequency", self.m_statusReportingFrequency);
    io("BsnIssuerId", self.m_bsnIssuerId);
    io("EnableBsn", self.m_enableBsn);
    io("AnonymizationParams", Fields::required(Fields::wrapped(
                                  "AnonParam", self.m_anonymizationParams, Fields::DropFailed)));
    io(KelExportDatabaseConfiguration::WELL_KNOWN_NAME, self.m_database);
}

CONFIGURATION_DEFINE(KelExportGlobalConfiguration, KelExportGlobalConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

KelExportGlobalConfiguration::KelExportGlobalConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelExport, false) {
}

KelExportConfigurationAdapter::KelExportConfigurationAdapter()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelExport, false) {
}

bool KelExportConfigurationAdapter::readVesk(const Vesk::Element& element) {
    return m_global.readVesk(element);
}

Quorvex::auto_ptr<Vesk::Element> KelExportConfigurationAdapter::writeVesk() const {
    return m_global.writeVesk();
}

bool operator==(const KelExportConfigurationAdapter& a, const KelExportConfigurationAdapter& b) {
    return a.m_global == b.m_global;
}

template <class Self, class Io>
void KelExportLocalConfiguration::fields(Self& self, Io& io) {
    io("KelExportAETitle", self.m_aeTitle);
    io("ImageCacheFolder", self.m_imageCacheFolder);
    io("MaximumImageCacheSize", self.m_maximumImageCacheSize);
    io("MaxItemsPerRetrieveRequest", self.m_maxItemsPerRetrieve);
    io("MaxItemsPerCancelRequest", self.m_maxItemsPerCancel);
    io("SchedulerReleaseTimeout", self.m_schedulerReleaseTimeout);
}

CONFIGURATION_DEFINE(KelExportLocalConfiguration, KelExportLocalConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

KelExportLocalConfiguration::KelExportLocalConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelExportLocal,
                     true) {}

namespace {
constexpr const char kDestinations[] = "KelExportRemoteSCPs";
}  // namespace

template <class Self, class Io>
void KelExportRemoteConfigurations::fields(Self& self, Io& io) {
    io("LongTermStorageDestination", self.m_longTermStorage);
    io(kDestinations, Fields::required(Fields::wrapped(KelExportRemoteScp::WELL_KNOWN_NAME,
                                                       self.m_destinations, Fields::DropFailed)));
}

CONFIGURATION_DEFINE_WRITE(KelExportRemoteConfigurations,
                           KelExportRemoteConfigurations::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_EQUAL(KelExportRemoteConfigurations)

// The convention's read, after making room for every destination the document holds.
bool KelExportRemoteConfigurations::readVesk(const Vesk::Element& element) {
    if (element.hasValue() && element.value().kind() == Vesk::Value::Kind::MultiElement) {
        const Vesk::Element* list = element.getMultiElement().find(Fields::keyOf(kDestinations));
        if (list != nullptr) {
            reserveForItems(*list, KelExportRemoteScp::WELL_KNOWN_NAME, m_destinations);
        }
    }
    return Fields::read(*this, element, "KelExportRemoteConfigurations",
                        Fields::FailureForm::Failed);
}

KelExportRemoteConfigurations::KelExportRemoteConfigurations()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelExportRemoteConfigurations,
          false) {}

template <class Self, class Io>
void KelExportWebService::fields(Self& self, Io& io) {
    io("ConnectionTimeout", self.m_connectionTimeout);
}

CONFIGURATION_DEFINE(KelExportWebService, KelExportWebService::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

KelExportWebService::KelExportWebService()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelExportWebServiceLocal,
          false) {}

}  // namespace Configuration
