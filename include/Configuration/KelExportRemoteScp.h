// Configuration::KelExportRemoteScp: one export destination: a remote DICOM node the export
// module sends studies to, with how it sends them.
//
// Element "KelExportRemoteScp". Written in declared order: the node (RemoteSCPConfiguration,
// child "RemoteScp"), "MaximumNumberOfConcurrentRequests" (unsigned short, 1),
// "ResendEntireStudyOnRetry" (flag, false), "KeepAssociationOpenAcrossStudies" (flag, false),
// "ForwardImages" (flag, true), "ForwardMPPS" (flag, false), "LocationAffinity" (string, empty),
// "HostAffinity" (string, empty), "BsnExport" (flag, false), "DestinationInUseByAutoExportRule"
// (flag, false), "StorageCommitScpConfiguration" (StorageCommitScpConfiguration, its defaults).
// Read in another order: the seven required own keys, then "ForwardImages" and "ForwardMPPS"
// (absent: their defaults, and the read still counts as complete), then "RemoteScp" (its absence
// is a logged read failure that ends the read), then the storage commitment settings only when
// the child exists.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/RemoteSCPConfiguration.h"
#include "Configuration/StorageCommitScpConfiguration.h"

namespace Configuration {

class CONFIGURATION_API KelExportRemoteScp : public RemoteSCPConfiguration {
    CONFIGURATION_CLASS(KelExportRemoteScp);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelExportRemoteScp";

    // How many requests the destination may serve at once.
    unsigned short getMaximumNumberOfConcurrentRequests() const { return m_maxRequests; }
    void setMaximumNumberOfConcurrentRequests(unsigned short count) { m_maxRequests = count; }
    // Whether a retry sends the whole study again.
    bool getResendEntireStudyOnRetry() const { return m_resendEntireStudy; }
    void setResendEntireStudyOnRetry(bool resend) { m_resendEntireStudy = resend; }
    // Whether one association serves several studies.
    bool getKeepAssociationOpenAcrossStudies() const { return m_keepAssociationOpen; }
    void setKeepAssociationOpenAcrossStudies(bool keep) { m_keepAssociationOpen = keep; }
    // Whether images are forwarded.
    bool getForwardImages() const { return m_forwardImages; }
    void setForwardImages(bool forward) { m_forwardImages = forward; }
    // Whether MPPS messages are forwarded.
    bool getForwardMPPS() const { return m_forwardMpps; }
    void setForwardMPPS(bool forward) { m_forwardMpps = forward; }
    // The location whose export servers serve this destination (empty: any).
    const ACE_CString& getLocationAffinity() const { return m_locationAffinity; }
    void setLocationAffinity(const ACE_CString& location) { m_locationAffinity = location; }
    // The host whose export server serves this destination (empty: any).
    const ACE_CString& getHostAffinity() const { return m_hostAffinity; }
    void setHostAffinity(const ACE_CString& host) { m_hostAffinity = host; }
    // Whether the citizen service number is exported.
    bool getBsnExport() const { return m_bsnExport; }
    void setBsnExport(bool exported) { m_bsnExport = exported; }
    // Whether an automatic export rule names this destination.
    bool getDestinationInUseByAutoExportRule() const { return m_inUseByRule; }
    void setDestinationInUseByAutoExportRule(bool used) { m_inUseByRule = used; }
    // The node asked for storage commitment of what was sent here.
    const StorageCommitScpConfiguration& getStorageCommitScpConfiguration() const {
        return m_storageCommit;
    }
    void setStorageCommitScpConfiguration(const StorageCommitScpConfiguration& settings) {
        m_storageCommit = settings;
    }

private:
    unsigned short m_maxRequests = 1;
    bool m_resendEntireStudy = false;
    bool m_keepAssociationOpen = false;
    bool m_forwardImages = true;
    bool m_forwardMpps = false;
    ACE_CString m_locationAffinity;
    ACE_CString m_hostAffinity;
    bool m_bsnExport = false;
    bool m_inUseByRule = false;
    StorageCommitScpConfiguration m_storageCommit;
};

}  // namespace Configuration
