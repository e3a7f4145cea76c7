// Configuration::OPS: direct access to one named configuration server, for tools and services
// that load and save documents without the process-wide repository. An OPS owns one shared
// HttpConfigurationClient for its server and loads and saves element trees and whole documents
// under one target host: the host given to the constructor, or the server's master host name
// when that is empty. It also lists hosts, reads the server information and fetches several
// documents in one request.
//
// Every operation returns 0 on success and -1 on failure (RetrieveAllConfigurations: -2 for an
// empty answer) and logs the failure at LM_DEBUG; none throws but GetWebClient. A constructor
// whose server cannot be reached leaves the object without a client: its operations then fail
// with -1 and GetWebClient throws. A call waits at most the client's time-out (35 s of silence).
//
// Ownership and threads: copies share one client (through SmartPtr). An OPS holds no lock;
// callers that share one between threads serialise their calls.
#pragma once

#include <ace/SString.h>

#include <map>
#include <vector>

#include "Configuration/ConfigDoc.h"
#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/ServerInfo.h"
#include "Configuration/SmartPtr.h"
#include "Quorvex/BDateTime.h"
#include "Vesk/Element.h"

namespace Configuration {

class CONFIGURATION_API OPS {
public:
    using CookieMap = std::map<ACE_CString, ACE_CString>;

    // A client of server with the machine's service ticket; secure asks for "https://".
    OPS(const ACE_CString& server, const ACE_CString& host, bool secure);
    // A client of server sending cookies; a non-empty map replaces the service ticket.
    OPS(const ACE_CString& server, const ACE_CString& host, const CookieMap& cookies);
    // A client with explicit URLs: scheme (with its colon, "https:") + "//" + server + "/" + path.
    // It contacts nobody on construction, so its host names stay empty until given.
    OPS(const ACE_CString& server, const ACE_CString& host, const ACE_CString& scheme,
        const ACE_CString& configurationPath, const ACE_CString& workflowPath,
        const CookieMap& cookies);

    // Replaces the cookies the client sends.
    void SetCookies(const CookieMap& cookies);
    // The shared client; throws std::exception when construction left none.
    SmartPtr<HttpConfigurationClient> GetWebClient() const;
    // The server's master host name (empty without a client).
    ACE_CString GetMasterHostName() const;
    // The host name the server reports for itself.
    const ACE_CString& GetHostName() const { return m_hostName; }
    // The host documents are loaded and saved under.
    const ACE_CString& GetTargetHost() const { return m_targetHost; }

    // Loads the stored tree of name (and its time, when the server reports it) into element.
    int LoadConfigVesk(const char* name, Vesk::Element& element, BDateTime& timestamp);
    // Stores element under name with timestamp (stamped now first when it is not valid), through
    // StoreMaster when master is true, else Store.
    int SaveConfigVesk(const char* name, Vesk::Element& element, BDateTime& timestamp, bool master);
    // Loads the document's tree under its path and fills it with readVesk (incomplete: -1).
    int LoadConfigDOC(ConfigDoc& document);
    // Stores the document's tree under its path; the document takes the time stored.
    int SaveConfigDOC(ConfigDoc& document, bool master);
    // Reads the server information into element.
    int LoadServerInfoVesk(Vesk::Element& element);
    // Reads the server information into info (an incomplete read: -1).
    int LoadServerInfoDoc(ServerInfo& info);
    // Every host the server knows.
    int ListHosts(std::vector<ACE_CString>& hosts);
    // Every host running a module of that type.
    int ListHostsByModuleType(int moduleType, std::vector<ACE_CString>& hosts);
    // Fetches several documents (names separated by ';' or ',') as one tree: 0, -1 on failure, or
    // -2 when the answer is empty (none of them exists); element is untouched unless 0.
    int RetrieveAllConfigurations(const ACE_CString& names, Vesk::Element& element);

private:
    void Initialize(bool secure, const ACE_CString& server, const ACE_CString& host,
                    const CookieMap& cookies);
    void adoptClient(const ACE_CString& host);

    SmartPtr<HttpConfigurationClient> m_client;
    ACE_CString m_hostName;
    ACE_CString m_targetHost;
};

}  // namespace Configuration
