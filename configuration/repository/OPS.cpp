#include "Configuration/OPS.h"

#include <stdexcept>

#include "Configuration/HttpConfigurationException.h"
#include "Quorvex/InputMemStream.h"
#include "Quorvex/InputZMemStream.h"
#include "Quorvex/Log.h"
#include "Quorvex/OutputZMemStream.h"
#include "Vesk/XmlUtils.h"

namespace Configuration {
namespace {

constexpr std::size_t kInitialCapacity = 5120;
constexpr int kCompressionLevel = 9;

// The stored bytes of element: its XML text, compressed.
void compress(const Vesk::Element& element, OutputZMemStream& out) {
    Vesk::XmlUtils::streamOut(element, out, Vesk::Ordering(), ACE_CString());
    out.flush();
}

}  // namespace

OPS::OPS(const ACE_CString& server, const ACE_CString& host, bool secure) {
    Initialize(secure, server, host, CookieMap());
}

OPS::OPS(const ACE_CString& server, const ACE_CString& host, const CookieMap& cookies) {
    Initialize(false, server, host, cookies);
}

OPS::OPS(const ACE_CString& server, const ACE_CString& host, const ACE_CString& scheme,
         const ACE_CString& configurationPath, const ACE_CString& workflowPath,
         const CookieMap& cookies) {
    m_client = std::make_shared<HttpConfigurationClient>(
        server, scheme, configurationPath, workflowPath, cookies.empty(), false, cookies);
    adoptClient(host);
}

// A non-empty cookie map stands in for the service ticket, which is then not fetched.
void OPS::Initialize(bool secure, const ACE_CString& server, const ACE_CString& host,
                     const CookieMap& cookies) {
    try {
        m_client =
            std::make_shared<HttpConfigurationClient>(server, cookies.empty(), secure, cookies);
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::Initialize: Unable to reach configuration server %s. Standard "
                    "Exception: %s.\n",
                    server.c_str(), e.what());
        m_targetHost = host;
        return;
    }
    adoptClient(host);
}

void OPS::adoptClient(const ACE_CString& host) {
    m_hostName = m_client->hostName();
    m_targetHost = host.length() > 0 ? host : m_client->masterHostName();
}

void OPS::SetCookies(const CookieMap& cookies) {
    if (m_client) {
        m_client->setCookies(cookies);
    }
}

SmartPtr<HttpConfigurationClient> OPS::GetWebClient() const {
    if (!m_client) {
        throw std::runtime_error("OPS::GetWebClient: No configuration client");
    }
    return m_client;
}

ACE_CString OPS::GetMasterHostName() const {
    return m_client ? m_client->masterHostName() : ACE_CString();
}

int OPS::LoadConfigVesk(const char* name, Vesk::Element& element, BDateTime& timestamp) {
    try {
        const HttpConfigurationClient& client = *GetWebClient();
        Quorvex::ByteArray bytes;
        std::size_t length = 0;
        client.retrieve(m_targetHost, name, bytes, length);
        InputZMemStream in(bytes.get(), length);
        Vesk::Element loaded;
        Vesk::XmlUtils::streamIn(in, loaded, ACE_CString());
        client.getTimeStamp(m_targetHost, name, timestamp);
        element = std::move(loaded);
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::LoadConfigVesk: Error checking if config exists. Standard Exception: "
                    "%s.",
                    e.what());
        return -1;
    }
}

int OPS::SaveConfigVesk(const char* name, Vesk::Element& element, BDateTime& timestamp,
                        bool master) {
    try {
        const HttpConfigurationClient& client = *GetWebClient();
        OutputZMemStream out(kInitialCapacity, kCompressionLevel);
        compress(element, out);
        if (!timestamp.isValid()) {
            timestamp = BDateTime::Now();
        }
        const ACE_CString time = timestamp.ToString();
        if (master) {
            client.storeMaster(m_targetHost, name, out.data(), out.size(), time);
        } else {
            client.store(m_targetHost, name, out.data(), out.size(), time);
        }
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::SaveConfigVesk: Error saving config %s. Standard Exception: %s.\n", name,
                    e.what());
        return -1;
    }
}

int OPS::LoadConfigDOC(ConfigDoc& document) {
    Vesk::Element element;
    BDateTime timestamp;
    if (LoadConfigVesk(document.path().c_str(), element, timestamp) != 0) {
        return -1;
    }
    document.timestamp(timestamp);
    if (!document.readVesk(element)) {
        QUORVEX_LOG(LM_DEBUG, "OPS::LoadConfigDOC: Error parsing configuration: %s\n",
                    document.path().c_str());
        return -1;
    }
    return 0;
}

int OPS::SaveConfigDOC(ConfigDoc& document, bool master) {
    Quorvex::auto_ptr<Vesk::Element> element;
    try {
        element = document.writeVesk();
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::SaveConfigDOC: Error writing configuration %s. Standard Exception: %s.\n",
                    document.path().c_str(), e.what());
        return -1;
    }
    BDateTime timestamp = document.timestamp();
    const int result = SaveConfigVesk(document.path().c_str(), *element, timestamp, master);
    if (result == 0) {
        document.timestamp(timestamp);
    }
    return result;
}

int OPS::LoadServerInfoVesk(Vesk::Element& element) {
    try {
        const ACE_CString text = GetWebClient()->getServerInformation();
        InputMemStream in(text.c_str(), text.length());
        Vesk::Element loaded;
        Vesk::XmlUtils::streamIn(in, loaded, ACE_CString());
        element = std::move(loaded);
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::LoadServerInfoVesk: Error reading server information. Standard "
                    "Exception: %s.\n",
                    e.what());
        return -1;
    }
}

int OPS::LoadServerInfoDoc(ServerInfo& info) {
    Vesk::Element element;
    if (LoadServerInfoVesk(element) != 0) {
        return -1;
    }
    if (!info.readVesk(element)) {
        QUORVEX_LOG(LM_DEBUG, "OPS::LoadServerInfoDoc: Incomplete server information.\n");
        return -1;
    }
    return 0;
}

int OPS::ListHosts(std::vector<ACE_CString>& hosts) {
    try {
        GetWebClient()->listHosts(hosts);
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG, "OPS::ListHosts: Error listing hosts. Standard Exception: %s.\n",
                    e.what());
        return -1;
    }
}

int OPS::ListHostsByModuleType(int moduleType, std::vector<ACE_CString>& hosts) {
    try {
        GetWebClient()->listHostsByModuleType(moduleType, hosts);
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::ListHostsByModuleType: Error listing hosts of module type %d. Standard "
                    "Exception: %s.\n",
                    moduleType, e.what());
        return -1;
    }
}

int OPS::RetrieveAllConfigurations(const ACE_CString& names, Vesk::Element& element) {
    try {
        const ACE_CString text = GetWebClient()->retrieveAllConfigurations(m_targetHost, names);
        if (text.length() == 0) {
            QUORVEX_LOG(LM_DEBUG,
                        "OPS::RetrieveAllConfigurations empty response for configurations %s\n",
                        names.c_str());
            return -2;
        }
        InputMemStream in(text.c_str(), text.length());
        Vesk::Element loaded;
        Vesk::XmlUtils::streamIn(in, loaded, ACE_CString());
        element = std::move(loaded);
        return 0;
    } catch (const HttpConfigurationException& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::RetrieveAllConfigurations http exception caught for configurations %s, "
                    "reason %s\n",
                    names.c_str(), e.what());
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "OPS::RetrieveAllConfigurations standard exception caught for configurations "
                    "%s, reason %s\n",
                    names.c_str(), e.what());
    }
    return -1;
}

}  // namespace Configuration
