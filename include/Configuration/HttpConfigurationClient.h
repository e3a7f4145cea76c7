// HttpConfigurationClient: the client of a configuration server's two HTTP services, the
// configuration service (documents, host lists, service registration, change signals) and the
// user-workflow service. Every call is one POST of a small XML body over a fresh connection to the
// server given at construction, judged either by the legacy "ReturnStatus" element or by HTTP
// status and error record; every failure reaches the caller as an HttpConfigurationException (or,
// where documented, a plain std::exception).
//
// Time-out: a call gives up when the server stays silent for 35 s, while connecting or while
// waiting for the answer. It is not a limit on the whole exchange: a large document on a slow
// link takes as long as it needs as long as bytes keep moving.
//
// Ownership and threads: a client is a plain value (copyable) that keeps no connection state; it
// holds no lock of its own and its operations only read its fields, so one client per thread (or a
// const client shared) is safe. The two process-wide host-name caches are shared by all clients:
// their first look-up takes no lock, filling them happens under their own process-wide mutex.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <map>
#include <vector>

#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationItemInfo.h"
#include "Configuration/SmartPtr.h"
#include "Configuration/UwfContactNameData.h"
#include "Configuration/UwfNodeData.h"
#include "Configuration/UwfUserData.h"
#include "Quorvex/auto_ptr.h"

class BDateTime;

namespace Configuration {

class CONFIGURATION_API HttpConfigurationClient {
public:
    using CookieMap = std::map<ACE_CString, ACE_CString>;

    // Root element of every user-workflow request.
    static constexpr const char* UWF_MESSAGE = "Message";
    // Element names of the configuration service's requests and answers.
    static constexpr const char* ELEMENT_HOST = "Host";
    static constexpr const char* ELEMENT_HOST_NAME = "HostName";
    static constexpr const char* ELEMENT_CONFIGURATION = "Configuration";
    static constexpr const char* ELEMENT_CONFIGURATION_NAME = "ConfigurationName";
    static constexpr const char* ELEMENT_CONFIGURATION_EXISTS = "ConfigurationExists";
    static constexpr const char* ELEMENT_CONFIGURATION_ITEM = "ConfigurationItem";
    static constexpr const char* ELEMENT_LAST_MODIFIED_TIME = "LastModifiedTime";
    static constexpr const char* ELEMENT_SERVER_INFO_BLOB = "ServerInfoBlob";
    static constexpr const char* ELEMENT_RETURN_STATUS = "ReturnStatus";
    static constexpr const char* ELEMENT_ERROR_MESSAGE = "ErrorMessage";
    static constexpr const char* ELEMENT_REGISTER_SERVICE = "RegisterService";
    static constexpr const char* ELEMENT_UNREGISTER_SERVICE = "UnregisterService";
    static constexpr const char* ELEMENT_SERVICE_NAME = "ServiceName";
    static constexpr const char* ELEMENT_CONNECTION_STRING = "ConnectionString";
    static constexpr const char* ELEMENT_SWITCHOVER_PERSISTENT = "SwitchoverPersistent";
    static constexpr const char* ELEMENT_PERSISTENT = "Persistent";
    static constexpr const char* ELEMENT_ENABLE_MERGE_NETWORK_CAPTURE = "EnableMergeNetworkCapture";
    static constexpr const char* ELEMENT_ENABLE = "Enable";
    // Cookie that carries the machine's service ticket.
    static constexpr const char* SERVICE_TICKET_COOKIE = "OrvelWebApplication";

    // A client of the services on server ("host" or "host:port"). With useServiceTicket the
    // machine's service ticket becomes the cookie "OrvelWebApplication"; useHttps selects TLS.
    // Asks the server for its host names unless this process already knows them.
    HttpConfigurationClient(const ACE_CString& server, bool useServiceTicket, bool useHttps,
                            const CookieMap& cookies = CookieMap());
    // A client with explicit URLs: scheme (with its colon, e.g. "https:") + "//" + server + "/" +
    // path. Fetches no ticket, ignores both flags and does not contact the server.
    HttpConfigurationClient(const ACE_CString& server, const ACE_CString& scheme,
                            const ACE_CString& configurationPath, const ACE_CString& workflowPath,
                            bool useServiceTicket, bool useHttps,
                            const CookieMap& cookies = CookieMap());
    HttpConfigurationClient(const HttpConfigurationClient& other) = default;
    HttpConfigurationClient& operator=(const HttpConfigurationClient& other) = default;
    ~HttpConfigurationClient() = default;

    // The configuration service's own host name, as it reported it.
    const ACE_CString& hostName() const { return m_hostName; }
    // The master configuration service's host name, as the service reported it.
    const ACE_CString& masterHostName() const { return m_masterHostName; }
    // Replaces the cookies sent with every request.
    void setCookies(const CookieMap& cookies) { m_cookies = cookies; }

    // Stores a document (Base64 on the wire); an empty time text sends no time.
    void store(const ACE_CString& host, const ACE_CString& configurationName,
               const unsigned char* data, std::size_t length,
               const ACE_CString& lastModifiedTime) const;
    // Stores a document on the master service.
    void storeMaster(const ACE_CString& host, const ACE_CString& configurationName,
                     const unsigned char* data, std::size_t length,
                     const ACE_CString& lastModifiedTime) const;
    // Fetches a document; the caller owns the decoded bytes.
    void retrieve(const ACE_CString& host, const ACE_CString& configurationName,
                  Quorvex::ByteArray& data, std::size_t& length) const;
    // Fetches several documents; returns the service's whole answer text, unread.
    ACE_CString retrieveAllConfigurations(const ACE_CString& host,
                                          const ACE_CString& configurationNames) const;
    // Whether a document exists (the service's answer is exactly "1", ignoring case).
    void checkForExistence(const ACE_CString& host, const ACE_CString& configurationName,
                           bool& exists) const;
    // The time the document was last changed.
    void getTimeStamp(const ACE_CString& host, const ACE_CString& configurationName,
                      BDateTime& timestamp) const;
    // The service's server information text.
    ACE_CString getServerInformation() const;
    // Every document of a host, in answer order.
    void listItems(const ACE_CString& host, std::vector<_HttpConfigurationItemInfo>& items) const;
    // Every host the service knows, in answer order.
    void listHosts(std::vector<ACE_CString>& hosts) const;
    // Every host running a module of the given type, in answer order.
    void listHostsByModuleType(int moduleType, std::vector<ACE_CString>& hosts) const;
    // Registers a service of a host under its connection string.
    void registerService(const ACE_CString& hostName, const ACE_CString& serviceName,
                         const ACE_CString& connectionString) const;
    // Unregisters a service of the configuration service's own host.
    void unregisterService(const ACE_CString& serviceName) const;
    // Makes the named storage the persistent one.
    void switchoverPersistent(const ACE_CString& persistentName) const;
    // Turns network capture merging on or off for a host.
    void enableMergeNetworkCapture(bool enable, const ACE_CString& host) const;
    // User-workflow operations: each sends <Message><Operation>parameters</Operation></Message>
    // (empty parameters left out) and judges the answer by HTTP status and error record, so a
    // removed node, a missing preference path and the folder and item limits arrive as their own
    // exception classes. Vectors are appended to, in answer order.

    // Creates a node; returns its id and sets lastModified to the service's time of the change.
    ACE_CString UwfCreateNode(const UwfNodeData& node, BDateTime& lastModified) const;
    // Updates a node; returns the service's time of the change.
    BDateTime UwfUpdateNode(const UwfNodeData& node) const;
    // Deletes a node (a folder with everything under it).
    void UwfDeleteNode(const ACE_CString& nodeId, const ACE_CString& userId,
                       UwfNodeData::NodeType type) const;
    // Puts an exam into a folder.
    void UwfInsertExamFolder(const ACE_CString& examKey, const ACE_CString& folderId) const;
    // Takes an exam out of a folder.
    void UwfDeleteExamFolder(const ACE_CString& examKey, const ACE_CString& folderId) const;
    // Whether an exam is in any folder.
    bool UwfIsProtectedExam(const ACE_CString& examKey) const;
    // Whether a node of that type (and id, if it exists) may live under parentId.
    bool UwfIsValidChild(const ACE_CString& id, const ACE_CString& parentId,
                         UwfNodeData::NodeType type) const;
    // Keeps the newest itemsToRetain items of a folder and deletes the others.
    void UwfPurgeFolder(const ACE_CString& folderId, int itemsToRetain,
                        const ACE_CString& userId) const;
    // Fills user with the service's record of the user.
    void UwfGetUserStatus(const ACE_CString& userId, UwfUserData& user) const;
    // Stores a user's record (name, type, folders, on-call flag).
    void UwfUpdateUserStatus(const UwfUserData& user) const;
    // Logs a user out.
    void UwfLogoutUser(const ACE_CString& userId) const;
    // Deletes a user with the user's folders, contact name and preferences.
    void UwfDeleteUser(const ACE_CString& userId) const;
    // Sets contactName to a new record with the user's contact name.
    void UwfGetContactNameData(const ACE_CString& userId,
                               SmartPtr<UwfContactNameData>& contactName) const;
    // Stores a user's preference under path.
    void UwfStorePreference(const ACE_CString& userId, const ACE_CString& path,
                            const ACE_CString& data) const;
    // A user's preference under path.
    ACE_CString UwfRetrievePreference(const ACE_CString& userId, const ACE_CString& path) const;
    // The preferences of the users (ids separated by ","), as the service's text.
    ACE_CString UwfRetrieveAllPreferences(const ACE_CString& userIds) const;
    // Appends the nodes of a folder changed after modifiedSince.
    void UwfGetFolderData(const ACE_CString& folderId, const BDateTime& modifiedSince,
                          std::vector<SmartPtr<UwfNodeData>>& nodes) const;
    // Logs a user in; appends the user's root folders.
    void UwfLoginUser(const UwfUserData& user, std::vector<SmartPtr<UwfNodeData>>& nodes) const;
    // Appends the users of a type (all types when empty), only logged-in ones if asked.
    void UwfListUsers(const ACE_CString& type, bool loggedInOnly,
                      std::vector<SmartPtr<UwfUserData>>& users) const;

    // Tells the service that this machine changed the configuration.
    void signalChanged() const;
    // Asks the service to restart.
    void signalRestart() const;
    // Asks the service to refresh.
    void signalRefresh() const;

    // Cuts the text of element tag out of text, searching from start: value gets the text with
    // XML entities replaced, next the position to continue from. False when it is not found.
    static bool findElementText(const ACE_CString& tag, const ACE_CString& text,
                                ACE_CString::size_type start, ACE_CString& value,
                                ACE_CString::size_type& next);

private:
    friend class HttpConfigurationClientTestAccess;
    class HostNameMap;

    void send(const ACE_CString& url, const ACE_CString& body, ACE_CString& response,
              bool legacy) const;
    void CheckResponse(const ACE_CString& statusCode, const ACE_CString& body, bool legacy) const;
    void checkLegacyResponse(const ACE_CString& body) const;
    ACE_CString retrieveHostName(const ACE_CString& server) const;
    ACE_CString retrieveMasterHostName(const ACE_CString& server) const;
    ACE_CString sendConfiguration(const ACE_CString& body) const;
    void collectHostNames(const ACE_CString& body, std::vector<ACE_CString>& hosts) const;
    ACE_CString sendWorkflow(const ACE_CString& body) const;

    ACE_CString m_configurationUrl;
    ACE_CString m_workflowUrl;
    ACE_CString m_hostName;
    ACE_CString m_masterHostName;
    ACE_CString m_server;
    int m_receiveTimeout;  // ms of silence after which a call gives up (35000)
    CookieMap m_cookies;

    static HostNameMap m_mapConfigurationServiceHostName;
    static HostNameMap m_mapConfigurationServiceMasterHostName;
};

}  // namespace Configuration
