// Configuration::TivoliServerInfo: one tape-archive (Tivoli Storage Manager) server and the
// account the archive uses on it. Element "TivoliServerInfo"; keys in order, all required (a
// missing one is a logged read failure naming it): "TivoliStorageManagerServerAddress" (""),
// "TivoliStorageManagerServerPort" (unsigned, 1500, the server's usual port),
// "TivoliServerUserAccount" (""), "TivoliServerAccessPassword" ("": a credential the deployment
// sets; it never reaches a log line, and tools print it masked).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API TivoliServerInfo : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(TivoliServerInfo);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "TivoliServerInfo";
    static constexpr unsigned int kDefaultPort = 1500;

    // The server's host name or address.
    const ACE_CString& getTivoliStorageManagerHostname() const { return m_address; }
    void setTivoliStorageManagerHostname(const ACE_CString& address) { m_address = address; }
    // The server's port.
    unsigned int getTivoliStorageManagerPort() const { return m_port; }
    void setTivoliStorageManagerPort(unsigned int port) { m_port = port; }
    // The account the archive logs on with.
    const ACE_CString& getTivoliServerUserAccount() const { return m_user; }
    void setTivoliServerUserAccount(const ACE_CString& user) { m_user = user; }
    // The account's password (a credential: never log or print it).
    const ACE_CString& getTivoliServerAccessPassword() const { return m_password; }
    void setTivoliServerAccessPassword(const ACE_CString& password) { m_password = password; }

private:
    ACE_CString m_address;
    unsigned int m_port = kDefaultPort;
    ACE_CString m_user;
    ACE_CString m_password;
};

}  // namespace Configuration
