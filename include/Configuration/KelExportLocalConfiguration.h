// Configuration::KelExportLocalConfiguration: the per-machine document "KelExportLocal": the
// export server's settings on one machine.
//
// Element "KelExportLocal"; keys in order, with defaults, all required: "KelExportAETitle"
// ("QUORVEX_SCU"), "ImageCacheFolder" ("c:\Quorvex\KelExportCache"), "MaximumImageCacheSize"
// (200), "MaxItemsPerRetrieveRequest" (25), "MaxItemsPerCancelRequest" (25),
// "SchedulerReleaseTimeout" (5) (numbers unsigned int).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelExportLocalConfiguration
    : public TypedConfigDoc<KelExportLocalConfiguration> {
    CONFIGURATION_CLASS(KelExportLocalConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelExportLocal";

    // This machine's document "KelExportLocal" with every value at its default.
    KelExportLocalConfiguration();

    // The AE title the export server calls from.
    const ACE_CString& getKelExportAETitle() const { return m_aeTitle; }
    void setKelExportAETitle(const ACE_CString& title) { m_aeTitle = title; }
    // The folder images are cached in before they are sent.
    const ACE_CString& getImageCacheFolder() const { return m_imageCacheFolder; }
    void setImageCacheFolder(const ACE_CString& folder) { m_imageCacheFolder = folder; }
    // The image cache's size limit.
    unsigned int getMaximumImageCacheSize() const { return m_maximumImageCacheSize; }
    void setMaximumImageCacheSize(unsigned int size) { m_maximumImageCacheSize = size; }
    // The most items one retrieve request carries.
    unsigned int getMaxItemsPerRetrieveRequest() const { return m_maxItemsPerRetrieve; }
    void setMaxItemsPerRetrieveRequest(unsigned int count) { m_maxItemsPerRetrieve = count; }
    // The most items one cancel request carries.
    unsigned int getMaxItemsPerCancelRequest() const { return m_maxItemsPerCancel; }
    void setMaxItemsPerCancelRequest(unsigned int count) { m_maxItemsPerCancel = count; }
    // How long the scheduler waits before releasing work.
    unsigned int getSchedulerReleaseTimeout() const { return m_schedulerReleaseTimeout; }
    void setSchedulerReleaseTimeout(unsigned int timeOut) { m_schedulerReleaseTimeout = timeOut; }

private:
    ACE_CString m_aeTitle = "QUORVEX_SCU";
    ACE_CString m_imageCacheFolder = "c:\\Quorvex\\KelExportCache";
    unsigned int m_maximumImageCacheSize = 200;
    unsigned int m_maxItemsPerRetrieve = 25;
    unsigned int m_maxItemsPerCancel = 25;
    unsigned int m_schedulerReleaseTimeout = 5;
};

}  // namespace Configuration
