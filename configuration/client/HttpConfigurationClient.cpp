// HttpConfigurationClient: construction, the transport operation send, the judgement of answers,
// the element scanner and the host-name caches. The configuration operations are in
// HttpConfigurationClientOperations.cpp.
#include "Configuration/HttpConfigurationClient.h"

#include <ace/OS_NS_strings.h>

#include <cstring>
#include <stdexcept>
#include <string>
#include <string_view>

#include "Client/ServiceTicketModule.h"
#include "Configuration/ErrorData.h"
#include "Configuration/HttpConfigurationException.h"
#include "Configuration/HttpConfigurationFolderLimitReachedException.h"
#include "Configuration/HttpConfigurationInvalidNodeIdException.h"
#include "Configuration/HttpConfigurationItemLimitReachedException.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/HttpConfigurationTransportException.h"
#include "Quorvex/Log.h"
#include "Quorvex/TextConversion.h"
#include "client/ElementText.h"
#include "client/HostNameMap.h"
#include "client/HttpTransport.h"

namespace Configuration {

namespace {

const int RECEIVE_TIMEOUT_MS = 35000;
const char* const CONFIGURATION_PATH = "/Sundrel/ConfigurationService/ConfigurationService.ashx";
const char* const WORKFLOW_PATH = "/Sundrel/UserWorkflowService/UserWorkFlow.ashx";
const char* const INVALID_NODE_ID_KEY = "CF919CA8-84FE-4214-9343-C24F6E6B92B2";
const char* const PATH_NOT_FOUND_KEY = "AF901DEB-1F70-41cf-879D-6EFC19168686";
const char* const FOLDER_LIMIT_CODE = "42794";
const char* const ITEM_LIMIT_CODE = "42795";

bool equalsIgnoringCase(const ACE_CString& a, const char* b) {
    return ACE_OS::strcasecmp(a.c_str(), b) == 0;
}

}  // namespace

HttpConfigurationClient::HostNameMap HttpConfigurationClient::m_mapConfigurationServiceHostName;
HttpConfigurationClient::HostNameMap
    HttpConfigurationClient::m_mapConfigurationServiceMasterHostName;

HttpConfigurationClient::HttpConfigurationClient(const ACE_CString& server, bool useServiceTicket,
                                                 bool useHttps, const CookieMap& cookies)
    : m_receiveTimeout(RECEIVE_TIMEOUT_MS), m_cookies(cookies) {
    if (useServiceTicket) {
        ACE_CString ticket;
        // A non-zero result (no ticket on this machine) leaves the client without the cookie.
        if (ServiceTicketModule::process().fetch(ticket) == 0) {
            m_cookies[SERVICE_TICKET_COOKIE] = ticket;
        }
    }
    m_server = server;
    const ACE_CString prefix = useHttps ? "https://" : "http://";
    m_configurationUrl = prefix + server + CONFIGURATION_PATH;
    m_workflowUrl = prefix + server + WORKFLOW_PATH;
    m_hostName = retrieveHostName(m_server);
    m_masterHostName = retrieveMasterHostName(m_server);
}

HttpConfigurationClient::HttpConfigurationClient(const ACE_CString& server,
                                                 const ACE_CString& scheme,
                                                 const ACE_CString& configurationPath,
                                                 const ACE_CString& workflowPath,
                                                 bool /*useServiceTicket*/, bool /*useHttps*/,
                                                 const CookieMap& cookies)
    : m_configurationUrl(scheme + "//" + server + "/" + configurationPath),
      m_workflowUrl(scheme + "//" + server + "/" + workflowPath),
      m_server(server),
      m_receiveTimeout(RECEIVE_TIMEOUT_MS),
      m_cookies(cookies) {}

void HttpConfigurationClient::send(const ACE_CString& url, const ACE_CString& body,
                                   ACE_CString& response, bool legacy) const {
    HttpTransport::Answer answer;
    const HttpTransport::Outcome outcome =
        HttpTransport::post(m_server, url, body, m_cookies, m_receiveTimeout, answer);
    if (outcome == HttpTransport::Outcome::NotSent) {
        QUORVEX_LOG(LM_DEBUG, "HttpConfigurationClient::send() - Send Transport Exception\n");
        throw HttpConfigurationTransportException(
            "HttpConfigurationClient::send::Unable to send http request\n");
    }
    if (outcome == HttpTransport::Outcome::NotReceived) {
        QUORVEX_LOG(LM_DEBUG, "HttpConfigurationClient::send() - Receive Transport Exception\n");
        throw HttpConfigurationTransportException(
            "HttpConfigurationClient::send error receiving HTTP response\n");
    }
    response.swap(answer.body);
    CheckResponse(answer.statusCode, response, legacy);
}

void HttpConfigurationClient::CheckResponse(const ACE_CString& statusCode, const ACE_CString& body,
                                            bool legacy) const {
    if (legacy) {
        checkLegacyResponse(body);
        return;
    }
    if (statusCode == "200") {
        return;
    }
    SmartPtr<ErrorData> error;
    try {
        error = ErrorData::Create();
        error->LoadXml(body);
    } catch (const std::exception&) {
        throw HttpConfigurationException("Return code: " + statusCode + " Response: " + body);
    }
    if (equalsIgnoringCase(error->ErrorKey, INVALID_NODE_ID_KEY)) {
        throw HttpConfigurationInvalidNodeIdException(error->ErrorMessage);
    }
    if (equalsIgnoringCase(error->ErrorKey, PATH_NOT_FOUND_KEY)) {
        throw HttpConfigurationPathNotFoundException(error->ErrorMessage);
    }
    if (equalsIgnoringCase(error->ErrorCode, FOLDER_LIMIT_CODE)) {
        throw HttpConfigurationFolderLimitReachedException(error->ErrorMessage);
    }
    if (equalsIgnoringCase(error->ErrorCode, ITEM_LIMIT_CODE)) {
        throw HttpConfigurationItemLimitReachedException(error->ErrorMessage);
    }
    throw HttpConfigurationException(error->ErrorKey, error->ErrorCode, error->ErrorMessage,
                                     error->ErrorOriginalStackTrace, error->LocalizedErrorMessage);
}

void HttpConfigurationClient::checkLegacyResponse(const ACE_CString& body) const {
    ACE_CString status;
    ACE_CString::size_type next = 0;
    if (!findElementText(ELEMENT_RETURN_STATUS, body, 0, status, next)) {
        throw HttpConfigurationException("Error in response: " + body);
    }
    // Only "0" is a failure; "1", "true", "-1" and anything else mean success.
    if (!equalsIgnoringCase(status, "0")) {
        return;
    }
    ACE_CString message;
    if (findElementText(ELEMENT_ERROR_MESSAGE, body, 0, message, next)) {
        // Deliberately not an HttpConfigurationException.
        throw std::runtime_error(message.c_str());
    }
    throw HttpConfigurationException("CheckResponse: request failed.");
}

bool locateElementText(std::string_view text, std::string_view tag, std::size_t start,
                       std::string_view& raw) {
    const std::string open = "<" + std::string(tag) + ">";
    const std::string close = "</" + std::string(tag) + ">";
    const auto openAt = text.find(open, start);
    if (openAt == std::string_view::npos) {
        return false;
    }
    const auto valueStart = openAt + open.size();
    if (valueStart >= text.size()) {
        return false;
    }
    const auto closeAt = text.find(close, valueStart);
    if (closeAt == std::string_view::npos) {
        return false;
    }
    raw = text.substr(valueStart, closeAt - valueStart);
    return true;
}

ACE_CString requiredElementText(const char* tag, const ACE_CString& answer, const char* missing) {
    ACE_CString value;
    ACE_CString::size_type next = 0;
    if (!HttpConfigurationClient::findElementText(tag, answer, 0, value, next)) {
        throw HttpConfigurationException(missing);
    }
    return value;
}

bool HttpConfigurationClient::findElementText(const ACE_CString& tag, const ACE_CString& text,
                                              ACE_CString::size_type start, ACE_CString& value,
                                              ACE_CString::size_type& next) {
    const std::string_view view(text.c_str(), text.length());
    std::string_view raw;
    if (!locateElementText(view, std::string_view(tag.c_str(), tag.length()), start, raw)) {
        return false;
    }
    if (std::memchr(raw.data(), '&', raw.size()) == nullptr) {
        value.set(raw.data(), raw.size(), true);  // no entity to replace (e.g. Base64 documents)
    } else {
        Quorvex::ConvertXmlStringToString(ACE_CString(raw.data(), raw.size()), value);
    }
    const std::size_t valueStart = static_cast<std::size_t>(raw.data() - view.data());
    const std::size_t closeLength = tag.length() + 3;
    // Counted with the replaced value's length, so it may fall inside the element just read;
    // harmless for the forward search.
    next = valueStart + value.length() + closeLength;
    if (next > view.size() - 1) {
        next = view.size() - 1;
    }
    return true;
}

ACE_CString HttpConfigurationClient::retrieveHostName(const ACE_CString& server) const {
    static const HostNameMap::Query query = {
        "<GetHostName></GetHostName>",
        "Unable to acquire lock to retrieve hostname for configuration service",
        "Unable to retrieve hostname for configuration service"};
    return m_mapConfigurationServiceHostName.retrieve(
        server, query, [this](const char* body) { return sendConfiguration(body); });
}

ACE_CString HttpConfigurationClient::retrieveMasterHostName(const ACE_CString& server) const {
    static const HostNameMap::Query query = {
        "<GetMasterHostName></GetMasterHostName>",
        "Unable to acquire lock to retrieve master hostname for configuration service",
        "Unable to retrieve the master hostname for configuration service"};
    return m_mapConfigurationServiceMasterHostName.retrieve(
        server, query, [this](const char* body) { return sendConfiguration(body); });
}

ACE_CString HttpConfigurationClient::sendConfiguration(const ACE_CString& body) const {
    ACE_CString response;
    send(m_configurationUrl, body, response, true);
    return response;
}

}  // namespace Configuration
