// Configuration::QrscpConfiguration: the site-wide document "Qrscp": the archive's own DICOM
// query/retrieve service provider: which AE titles may query it, its AE title and port, threads
// and limits, TLS files.
//
// Element "Qrscp"; keys as written, with defaults, all required: "AllowedAeTitles" (a list value
// of AE titles, in order; empty), "AllowAllAeTitles" (false), "QrscpAeTitle" ("QUORVEX_QRP"),
// "NumberOfThreads" (5), "Port" (107, not the DICOM default 104), "MoveCompletionPollInterval"
// (3), "IncludeExceptionsInQueries" (true), "MaxDatabaseResults" (1000), "UseSSL" (false),
// "PrivateKeyFile", "CertificateFile" (file paths; empty). Read in another order:
// "AllowAllAeTitles", "NumberOfThreads", "Port", "QrscpAeTitle", "MoveCompletionPollInterval",
// "IncludeExceptionsInQueries", "MaxDatabaseResults", "AllowedAeTitles", "UseSSL",
// "CertificateFile", "PrivateKeyFile".
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API QrscpConfiguration : public TypedConfigDoc<QrscpConfiguration> {
    CONFIGURATION_CLASS(QrscpConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "Qrscp";

    // The site-wide document "Qrscp" with every value at its default.
    QrscpConfiguration();

    // The AE titles allowed to query (applied by the provider when not all are allowed).
    const std::vector<ACE_CString>& getAllowedAeTitles() const { return m_allowedAeTitles; }
    void setAllowedAeTitles(const std::vector<ACE_CString>& titles) { m_allowedAeTitles = titles; }
    // Whether every AE title may query.
    bool getAllowAllAeTitles() const { return m_allowAllAeTitles; }
    void setAllowAllAeTitles(bool allow) { m_allowAllAeTitles = allow; }
    // The provider's own AE title.
    const ACE_CString& getQrscpAeTitle() const { return m_qrscpAeTitle; }
    void setQrscpAeTitle(const ACE_CString& title) { m_qrscpAeTitle = title; }
    // How many threads serve associations.
    int getNumberOfThreads() const { return m_numberOfThreads; }
    void setNumberOfThreads(int count) { m_numberOfThreads = count; }
    // The port the provider listens on.
    int getPort() const { return m_port; }
    void setPort(int port) { m_port = port; }
    // How often a move checks for completion.
    int getMoveCompletionPollInterval() const { return m_moveCompletionPollInterval; }
    void setMoveCompletionPollInterval(int interval) { m_moveCompletionPollInterval = interval; }
    // Whether queries include exceptions (key "IncludeExceptionsInQueries").
    bool getIncludeExceptions() const { return m_includeExceptions; }
    void setIncludeExceptions(bool include) { m_includeExceptions = include; }
    // The most database rows one query returns.
    int getMaxDatabaseResults() const { return m_maxDatabaseResults; }
    void setMaxDatabaseResults(int count) { m_maxDatabaseResults = count; }
    // Whether associations use TLS.
    bool getUseSSL() const { return m_useSSL; }
    void setUseSSL(bool use) { m_useSSL = use; }
    // The path of the TLS private key file (key "PrivateKeyFile").
    const ACE_CString& getSSLPrivateKey() const { return m_privateKeyFile; }
    void setSSLPrivateKey(ACE_CString path) { m_privateKeyFile = path; }
    // The path of the TLS certificate file (key "CertificateFile").
    const ACE_CString& getSSLCertificate() const { return m_certificateFile; }
    void setSSLCertificate(ACE_CString path) { m_certificateFile = path; }

private:
    std::vector<ACE_CString> m_allowedAeTitles;
    bool m_allowAllAeTitles = false;
    ACE_CString m_qrscpAeTitle = "QUORVEX_QRP";
    int m_numberOfThreads = 5;
    int m_port = 107;
    int m_moveCompletionPollInterval = 3;
    bool m_includeExceptions = true;
    int m_maxDatabaseResults = 1000;
    bool m_useSSL = false;
    ACE_CString m_privateKeyFile;
    ACE_CString m_certificateFile;
};

}  // namespace Configuration
