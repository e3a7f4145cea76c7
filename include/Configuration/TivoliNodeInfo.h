// Configuration::TivoliNodeInfo: how an archive node works with one Tivoli server. Element
// "TivoliNodeInfo"; keys in order with defaults: "TivoliServer" (the server's address, ""),
// "TivoliServerBlockTransferSize" (bytes, 262144), "NumberThreads" (4), "TivoliSessionTimeout"
// (seconds, 600), "UnarchivedStudiesPollingInterval" (seconds, 300).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API TivoliNodeInfo : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(TivoliNodeInfo);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "TivoliNodeInfo";

    // The address of the server these settings are for.
    const ACE_CString& getTivoliServer() const { return m_server; }
    void setTivoliServer(const ACE_CString& server) { m_server = server; }
    // Bytes sent to the server per block.
    unsigned int getTivoliServerBlockTransferSize() const { return m_blockSize; }
    void setTivoliServerBlockTransferSize(unsigned int bytes) { m_blockSize = bytes; }
    // Threads archiving to the server.
    unsigned int getNumberThreads() const { return m_threads; }
    void setNumberThreads(unsigned int threads) { m_threads = threads; }
    // Seconds before an idle session is closed.
    unsigned int getTivoliSessionTimeout() const { return m_sessionTimeout; }
    void setTivoliSessionTimeout(unsigned int seconds) { m_sessionTimeout = seconds; }
    // Seconds between looks for studies not yet archived.
    unsigned int getUnarchivedStudiesPollingInterval() const { return m_pollingInterval; }
    void setUnarchivedStudiesPollingInterval(unsigned int seconds) { m_pollingInterval = seconds; }

private:
    ACE_CString m_server;
    unsigned int m_blockSize = 262144;
    unsigned int m_threads = 4;
    unsigned int m_sessionTimeout = 600;
    unsigned int m_pollingInterval = 300;
};

}  // namespace Configuration
