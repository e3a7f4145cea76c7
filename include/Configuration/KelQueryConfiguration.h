// Configuration::KelQueryConfiguration: the site-wide document "KelQuery": the query module's
// limits and time-outs, the remote archives it queries and its prefetch settings.
//
// Element "KelQuery"; keys as written, with defaults, all required but the last:
// "MaxConcurrentArchiveMoves" (3), "MoveAttemptCount" (18), "QueryTimeout" (60), "MoveTimeout"
// (600), "MoveTimeoutOnError" (600), "KelQueryAETitle" ("QUORVEX_QRU"), "CleanupInterval" (30),
// "LongTermStorageArchive" (string, empty), "ConnectionPoolingEnabled" (1: a number, 0 off, any
// other value on), "MaxConnectionsInPool" (10), "MaxResultsPerQuery" (50) (numbers unsigned
// int), "Archives" (one "KelQueryRemoteScp" each; required: its absence is a logged read failure
// that keeps the list; an archive whose read is incomplete is dropped and makes the read
// incomplete), "Prefetch" (PrefetchConfiguration__; optional: absent, the settings stay).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/KelQueryRemoteSCPConfiguration.h"
#include "Configuration/PrefetchConfiguration__.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelQueryConfiguration : public TypedConfigDoc<KelQueryConfiguration> {
    CONFIGURATION_CLASS(KelQueryConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelQuery";

    // The site-wide document "KelQuery" with every value at its default.
    KelQueryConfiguration();

    // How many moves from archives run at once.
    unsigned int getMaxConcurrentArchiveMoves() const { return m_maxConcurrentMoves; }
    void setMaxConcurrentArchiveMoves(unsigned int count) { m_maxConcurrentMoves = count; }
    // How often a move is attempted.
    unsigned int getMoveAttemptCount() const { return m_moveAttemptCount; }
    void setMoveAttemptCount(unsigned int count) { m_moveAttemptCount = count; }
    // How long a query may take.
    unsigned int getQueryTimeout() const { return m_queryTimeout; }
    void setQueryTimeout(unsigned int timeOut) { m_queryTimeout = timeOut; }
    // How long a move may take.
    unsigned int getMoveTimeout() const { return m_moveTimeout; }
    void setMoveTimeout(unsigned int timeOut) { m_moveTimeout = timeOut; }
    // How long a move may take after an error.
    unsigned int getMoveTimeoutOnError() const { return m_moveTimeoutOnError; }
    void setMoveTimeoutOnError(unsigned int timeOut) { m_moveTimeoutOnError = timeOut; }
    // The AE title the query module calls from.
    const ACE_CString& getKelQueryAETitle() const { return m_aeTitle; }
    void setKelQueryAETitle(const ACE_CString& title) { m_aeTitle = title; }
    // How often finished work is cleaned up.
    unsigned int getCleanupInterval() const { return m_cleanupInterval; }
    void setCleanupInterval(unsigned int interval) { m_cleanupInterval = interval; }
    // The archive used for long-term storage (empty: none).
    const ACE_CString& getLongTermStorageArchive() const { return m_longTermStorageArchive; }
    void setLongTermStorageArchive(const ACE_CString& name) { m_longTermStorageArchive = name; }
    // Connection pooling: 0 off, any other value on (a number, not a flag).
    unsigned int getConnectionPoolingEnabled() const { return m_connectionPooling; }
    void setConnectionPoolingEnabled(unsigned int enabled) { m_connectionPooling = enabled; }
    // The most pooled connections.
    unsigned int getMaxConnectionsInPool() const { return m_maxConnectionsInPool; }
    void setMaxConnectionsInPool(unsigned int count) { m_maxConnectionsInPool = count; }
    // The most results one query returns.
    unsigned int getMaxResultsPerQuery() const { return m_maxResultsPerQuery; }
    void setMaxResultsPerQuery(unsigned int count) { m_maxResultsPerQuery = count; }
    // The remote archives, in stored order.
    const std::vector<KelQueryRemoteSCPConfiguration>& getArchives() const { return m_archives; }
    void setArchives(const std::vector<KelQueryRemoteSCPConfiguration>& archives) {
        m_archives = archives;
    }
    // The prefetch settings.
    const PrefetchConfiguration__& getPrefetchConfiguration() const { return m_prefetch; }
    void setPrefetchConfiguration(const PrefetchConfiguration__& prefetch) {
        m_prefetch = prefetch;
    }

private:
    unsigned int m_maxConcurrentMoves = 3;
    unsigned int m_moveAttemptCount = 18;
    unsigned int m_queryTimeout = 60;
    unsigned int m_moveTimeout = 600;
    unsigned int m_moveTimeoutOnError = 600;
    ACE_CString m_aeTitle = "QUORVEX_QRU";
    unsigned int m_cleanupInterval = 30;
    ACE_CString m_longTermStorageArchive;
    unsigned int m_connectionPooling = 1;
    unsigned int m_maxConnectionsInPool = 10;
    unsigned int m_maxResultsPerQuery = 50;
    std::vector<KelQueryRemoteSCPConfiguration> m_archives;
    PrefetchConfiguration__ m_prefetch;
};

}  // namespace Configuration
