// Configuration::SSCPConfiguration: the site-wide document "DicomScp": the archive's DICOM storage
// service provider: its AE titles and port, association and PDU limits, study UID generation,
// TLS files, the error folder's size limit and the DICOM sources it knows.
//
// Element "StorageSCP"; keys as written, with defaults: "NormalAETitle" ("QUORVEX_SCP"),
// "HighPriorityAETitle" ("QUORVEX_HI"), "Port" (104), "LargeImageSize" (8388608),
// "MergeLibraryMinimumCallbackDataSize" (0), "ForceAssociation" (false),
// "OverwriteAssociationTags" (false), "CatchUnhandledExceptions" (true),
// "MergeLibraryMaxPduLength" (64512), "GenerateSuid" (false), "AppendStudyDateToGeneratedSuid"
// (true), "ReplaceNonLatin1DuringImport" (false), "SuidGenerationAETitleFilter" (a list value of
// AE titles, a set that ignores case; empty), "DicomSources" (one "ServerDicomSource" each;
// empty), "UseSSL" (false), "CertificateFile", "PrivateKeyFile" (file paths; empty),
// "DicomErrorFolderMaxSizeinGB" (5). Every key is required. Reading takes the sources last: a
// source whose read is incomplete is dropped (the read then incomplete); an absent or unreadable
// "DicomSources" makes the read incomplete without a log line; an empty one means no sources.
// Other failures are logged as "SSCPConfiguration::readVesk: Failed - using partial defaults.
// Standard Exception: %s\n".
//
// Accessor names differ from some keys on purpose (getHiPriorityAETitle, getMaxPduSize, ...);
// setPort(int) sets the minimum callback data size, setPort(unsigned int) the port.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <set>
#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/NoCaseCompare.h"
#include "Configuration/ServerDicomSource.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API SSCPConfiguration : public TypedConfigDoc<SSCPConfiguration> {
    CONFIGURATION_CLASS(SSCPConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "StorageSCP";
    // AE titles, ordered and compared without regard to case.
    using AETitleSet = std::set<ACE_CString, NoCaseCompare>;

    // The site-wide document "DicomScp" with every value at its default.
    SSCPConfiguration();

    // The AE title for normal traffic.
    const ACE_CString& getNormalAETitle() const { return m_normalAETitle; }
    void setNormalAETitle(const ACE_CString& title) { m_normalAETitle = title; }
    // The AE title for high-priority traffic (key "HighPriorityAETitle").
    const ACE_CString& getHiPriorityAETitle() const { return m_highPriorityAETitle; }
    void setHiPriorityAETitle(const ACE_CString& title) { m_highPriorityAETitle = title; }
    // The port the provider listens on.
    unsigned int getPort() const { return m_port; }
    void setPort(unsigned int port) { m_port = port; }
    // Whether associations are accepted whatever they propose.
    bool getForceAssociation() const { return m_forceAssociation; }
    void setForceAssociation(bool force) { m_forceAssociation = force; }
    // Whether association values overwrite the objects' own tags.
    bool getOverwriteAssociationTags() const { return m_overwriteAssociationTags; }
    void setOverwriteAssociationTags(bool overwrite) { m_overwriteAssociationTags = overwrite; }
    // Whether the provider catches unhandled exceptions (key "CatchUnhandledExceptions").
    bool getCatchUnhandledException() const { return m_catchUnhandledExceptions; }
    void setCatchUnhandledException(bool catchThem) { m_catchUnhandledExceptions = catchThem; }
    // The minimum callback data size of the DICOM toolkit.
    int getMergeLibraryMinimumCallbackDataSize() const { return m_minimumCallbackDataSize; }
    // Sets the minimum callback data size (not the port: the overload is kept as it is).
    void setPort(int size) { m_minimumCallbackDataSize = size; }
    // The maximum PDU length (key "MergeLibraryMaxPduLength"); no setter.
    int getMaxPduSize() const { return m_maxPduLength; }
    // Whether the provider generates study instance UIDs.
    bool getGenerateSuid() const { return m_generateSuid; }
    void setGenerateSuid(bool generate) { m_generateSuid = generate; }
    // Whether the study date is appended to a generated study UID.
    bool getAppendStudyDateToGeneratedSuid() const { return m_appendStudyDate; }
    void setAppendStudyDateToGeneratedSuid(bool append) { m_appendStudyDate = append; }
    // The AE titles whose studies get generated UIDs.
    const AETitleSet& getSuidGenerationAETitleFilter() const { return m_suidFilter; }
    void setSuidGenerationAETitleFilter(const AETitleSet& filter) { m_suidFilter = filter; }
    // The known DICOM sources, in stored order.
    const std::vector<ServerDicomSource>& getDicomSources() const { return m_sources; }
    // Whether associations use TLS.
    bool getUseSSL() const { return m_useSSL; }
    void setUseSSL(bool use) { m_useSSL = use; }
    // The path of the TLS private key file (key "PrivateKeyFile").
    const ACE_CString& getSSLPrivateKey() const { return m_privateKeyFile; }
    void setSSLPrivateKey(ACE_CString path) { m_privateKeyFile = path; }
    // The path of the TLS certificate file (key "CertificateFile").
    const ACE_CString& getSSLCertificate() const { return m_certificateFile; }
    void setSSLCertificate(ACE_CString path) { m_certificateFile = path; }
    // Objects from this size on are large; no setter.
    unsigned int getLargeImageSize() const { return m_largeImageSize; }
    // The error folder's size limit in GB.
    unsigned int getDicomErrorFolderMaxSizeinGB() const { return m_errorFolderMaxSizeInGB; }
    void setDicomErrorFolderMaxSizeinGB(unsigned int size) { m_errorFolderMaxSizeInGB = size; }
    // Whether characters outside Latin-1 are replaced while importing.
    bool getReplaceNonLatin1DuringImport() const { return m_replaceNonLatin1; }
    void setReplaceNonLatin1DuringImport(bool replace) { m_replaceNonLatin1 = replace; }

private:
    ACE_CString m_normalAETitle = "QUORVEX_SCP";
    ACE_CString m_highPriorityAETitle = "QUORVEX_HI";
    unsigned int m_port = 104;
    bool m_forceAssociation = false;
    bool m_overwriteAssociationTags = false;
    bool m_catchUnhandledExceptions = true;
    int m_minimumCallbackDataSize = 0;
    int m_maxPduLength = 64512;
    bool m_generateSuid = false;
    bool m_appendStudyDate = true;
    AETitleSet m_suidFilter;
    std::vector<ServerDicomSource> m_sources;
    bool m_useSSL = false;
    ACE_CString m_privateKeyFile;
    ACE_CString m_certificateFile;
    unsigned int m_largeImageSize = 8388608;
    unsigned int m_errorFolderMaxSizeInGB = 5;
    bool m_replaceNonLatin1 = false;
};

}  // namespace Configuration
