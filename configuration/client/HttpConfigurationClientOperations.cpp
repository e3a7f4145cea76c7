// HttpConfigurationClient: the operations of the configuration service. Each builds one request
// body, sends it and cuts its result out of the answer. Document operations wrap every failure
// into an HttpConfigurationException whose message starts with the operation's prefix.
#include <ace/OS_NS_strings.h>

#include <cstdio>
#include <cstring>
#include <stdexcept>

#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationException.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/Base64Coder.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlEmitter.h"
#include "client/ElementText.h"

namespace Configuration {

namespace {

using Client = HttpConfigurationClient;

// Runs operation; any std::exception is logged with logFormat and rethrown as an
// HttpConfigurationException whose message is prefix + what().
template <class Operation>
void wrapFailures(const char* logFormat, const char* prefix, Operation operation) {
    try {
        operation();
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG, logFormat, e.what());
        throw HttpConfigurationException(ACE_CString(prefix) + e.what());
    }
}

ACE_CString element(const char* tag, const ACE_CString& value) {
    return ACE_CString("<") + tag + ">" + value + "</" + tag + ">";
}

// "<Host>host</Host><ConfigurationName>name</ConfigurationName>", values as they stand.
ACE_CString hostAndName(const ACE_CString& host, const ACE_CString& configurationName) {
    return element(Client::ELEMENT_HOST, host) +
           element(Client::ELEMENT_CONFIGURATION_NAME, configurationName);
}

ACE_CString storeBody(const char* root, const ACE_CString& host,
                      const ACE_CString& configurationName, const unsigned char* data,
                      std::size_t length, const ACE_CString& lastModifiedTime) {
    ACE_CString inner = hostAndName(host, configurationName) +
                        element(Client::ELEMENT_CONFIGURATION, Base64Coder::Encode(data, length));
    if (!lastModifiedTime.empty()) {
        inner += element(Client::ELEMENT_LAST_MODIFIED_TIME, lastModifiedTime);
    }
    return element(root, inner);
}

// The document of a retrieve answer: its Base64 text decoded where it stands in the answer (a
// document's text holds no entity; one that does is read through findElementText like any text).
Quorvex::ByteArray decodeDocument(const ACE_CString& answer, const char* missing,
                                  std::size_t& length) {
    std::string_view raw;
    if (locateElementText(std::string_view(answer.c_str(), answer.length()),
                          Client::ELEMENT_CONFIGURATION, 0, raw) &&
        std::memchr(raw.data(), '&', raw.size()) == nullptr) {
        return Base64Coder::Decode(raw.data(), raw.size(), length);
    }
    return Base64Coder::Decode(requiredElementText(Client::ELEMENT_CONFIGURATION, answer, missing),
                               length);
}

// A body written by the XML emitter: root holding one escaped text element per parameter, in
// order; empty values are written too.
ACE_CString emittedBody(const char* root,
                        std::initializer_list<std::pair<const char*, ACE_CString>> parameters) {
    OutputMemStream out;
    Vesk::XmlEmitter xml(out);
    xml.startElement(root);
    for (const auto& parameter : parameters) {
        xml.textElement(parameter.first, parameter.second);
    }
    xml.endElement();
    return ACE_CString(out.data(), out.size());
}

}  // namespace

void HttpConfigurationClient::store(const ACE_CString& host, const ACE_CString& configurationName,
                                    const unsigned char* data, std::size_t length,
                                    const ACE_CString& lastModifiedTime) const {
    wrapFailures("HttpConfigurationClient::store: Standard Exception: %s\n",
                 "HttpConfigurationClient::store ", [&] {
                     sendConfiguration(storeBody("Store", host, configurationName, data, length,
                                                 lastModifiedTime));
                 });
}

void HttpConfigurationClient::storeMaster(const ACE_CString& host,
                                          const ACE_CString& configurationName,
                                          const unsigned char* data, std::size_t length,
                                          const ACE_CString& lastModifiedTime) const {
    // Shares store's prefix, deliberately.
    wrapFailures("HttpConfigurationClient::storeMaster: Standard Exception: %s\n",
                 "HttpConfigurationClient::store ", [&] {
                     sendConfiguration(storeBody("StoreMaster", host, configurationName, data,
                                                 length, lastModifiedTime));
                 });
}

void HttpConfigurationClient::retrieve(const ACE_CString& host,
                                       const ACE_CString& configurationName,
                                       Quorvex::ByteArray& data, std::size_t& length) const {
    wrapFailures("HttpConfigurationClient::retrieve: Standard Exception: %s\n",
                 "HttpConfigurationClient::retrieve: ", [&] {
                     const ACE_CString answer = sendConfiguration(
                         element("Retrieve", hostAndName(host, configurationName)));
                     std::size_t decodedLength = 0;
                     Quorvex::ByteArray decoded = decodeDocument(
                         answer, "No configuration found in response", decodedLength);
                     data = std::move(decoded);
                     length = decodedLength;
                 });
}

ACE_CString HttpConfigurationClient::retrieveAllConfigurations(
    const ACE_CString& host, const ACE_CString& configurationNames) const {
    ACE_CString answer;
    wrapFailures("HttpConfigurationClient::retrieve: Standard Exception: %s\n",
                 "HttpConfigurationClient::retrieve: ", [&] {
                     send(m_configurationUrl,
                          element("RetrieveItems", hostAndName(host, configurationNames)), answer,
                          false);
                 });
    return answer;
}

void HttpConfigurationClient::checkForExistence(const ACE_CString& host,
                                                const ACE_CString& configurationName,
                                                bool& exists) const {
    wrapFailures("HttpConfigurationClient::checkForExistence: Standard Exception: %s\n",
                 "HttpConfigurationClient::checkForExistence ", [&] {
                     const ACE_CString answer =
                         sendConfiguration(element("Exists", hostAndName(host, configurationName)));
                     const ACE_CString value =
                         requiredElementText(ELEMENT_CONFIGURATION_EXISTS, answer,
                                             "ConfigurationExists not found in response");
                     exists = ACE_OS::strcasecmp(value.c_str(), "1") == 0;
                 });
}

void HttpConfigurationClient::getTimeStamp(const ACE_CString& host,
                                           const ACE_CString& configurationName,
                                           BDateTime& timestamp) const {
    wrapFailures("HttpConfigurationClient::getLastModifiedTime: Standard Exception: %s\n",
                 "HttpConfigurationClient::getLastModifiedTime ", [&] {
                     const ACE_CString answer = sendConfiguration(
                         element("GetLastModifiedTime", hostAndName(host, configurationName)));
                     timestamp =
                         BDateTime(requiredElementText(ELEMENT_LAST_MODIFIED_TIME, answer,
                                                       "Last modified time not found in response"));
                 });
}

ACE_CString HttpConfigurationClient::getServerInformation() const {
    const ACE_CString answer = sendConfiguration("<GetServerInfo></GetServerInfo>");
    ACE_CString value;
    ACE_CString::size_type next = 0;
    if (!findElementText(ELEMENT_SERVER_INFO_BLOB, answer, 0, value, next)) {
        // The host-name text, deliberately.
        throw std::runtime_error("Unable to retrieve hostname for configuration service");
    }
    return value;
}

void HttpConfigurationClient::listItems(const ACE_CString& host,
                                        std::vector<_HttpConfigurationItemInfo>& items) const {
    items.clear();
    const ACE_CString answer = sendConfiguration(element("ListItems", element(ELEMENT_HOST, host)));
    ACE_CString item;
    ACE_CString::size_type position = 0;
    while (findElementText(ELEMENT_CONFIGURATION_ITEM, answer, position, item, position)) {
        _HttpConfigurationItemInfo info;
        info.host = requiredElementText(ELEMENT_HOST_NAME, item,
                                        "HttpConfigurationClient::listItems host not found");
        info.configurationName =
            requiredElementText(ELEMENT_CONFIGURATION_NAME, item,
                                "HttpConfigurationClient::listItems configurationName not found");
        info.lastModifiedTime =
            requiredElementText(ELEMENT_LAST_MODIFIED_TIME, item,
                                "HttpConfigurationClient::listItems lastModifiedTime not found");
        items.push_back(info);
    }
}

void HttpConfigurationClient::listHosts(std::vector<ACE_CString>& hosts) const {
    hosts.clear();
    collectHostNames("<ListHosts></ListHosts>", hosts);
}

void HttpConfigurationClient::listHostsByModuleType(int moduleType,
                                                    std::vector<ACE_CString>& hosts) const {
    hosts.clear();
    char body[128];
    std::snprintf(body, sizeof body,
                  "<ListHostsByModuleType><ModuleTypeFilter>%d</ModuleTypeFilter>"
                  "</ListHostsByModuleType>",
                  moduleType);
    collectHostNames(body, hosts);
}

void HttpConfigurationClient::collectHostNames(const ACE_CString& body,
                                               std::vector<ACE_CString>& hosts) const {
    const ACE_CString answer = sendConfiguration(body);
    ACE_CString host;
    ACE_CString::size_type position = 0;
    while (findElementText(ELEMENT_HOST_NAME, answer, position, host, position)) {
        hosts.push_back(host);
    }
}

void HttpConfigurationClient::registerService(const ACE_CString& hostName,
                                              const ACE_CString& serviceName,
                                              const ACE_CString& connectionString) const {
    // The connection string may hold credentials: it is not logged.
    QUORVEX_LOG(LM_DEBUG, "HttpConfigurationClient::registerService: Register service %s with %s\n",
                serviceName.c_str(), hostName.c_str());
    sendConfiguration(
        emittedBody(ELEMENT_REGISTER_SERVICE, {{ELEMENT_HOST_NAME, hostName},
                                               {ELEMENT_SERVICE_NAME, serviceName},
                                               {ELEMENT_CONNECTION_STRING, connectionString}}));
}

void HttpConfigurationClient::unregisterService(const ACE_CString& serviceName) const {
    sendConfiguration(
        emittedBody(ELEMENT_UNREGISTER_SERVICE,
                    {{ELEMENT_HOST_NAME, m_hostName}, {ELEMENT_SERVICE_NAME, serviceName}}));
}

void HttpConfigurationClient::switchoverPersistent(const ACE_CString& persistentName) const {
    sendConfiguration(
        emittedBody(ELEMENT_SWITCHOVER_PERSISTENT, {{ELEMENT_PERSISTENT, persistentName}}));
}

void HttpConfigurationClient::enableMergeNetworkCapture(bool enable,
                                                        const ACE_CString& host) const {
    sendConfiguration(emittedBody(ELEMENT_ENABLE_MERGE_NETWORK_CAPTURE,
                                  {{ELEMENT_ENABLE, enable ? "1" : "0"}, {ELEMENT_HOST, host}}));
}

void HttpConfigurationClient::signalChanged() const {
    sendConfiguration(element("Changed", element("FromServer", Quorvex::GetHostName(false))));
}

void HttpConfigurationClient::signalRestart() const {
    sendConfiguration("<Restart></Restart>");
}

void HttpConfigurationClient::signalRefresh() const {
    sendConfiguration("<Refresh></Refresh>");
}

}  // namespace Configuration
