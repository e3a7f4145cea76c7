// HttpConfigurationClient: the operations of the user-workflow service. Each writes one
// <Message> request with the XML emitter, sends it judged by HTTP status, and cuts its result
// out of the answer.
#include <functional>
#include <initializer_list>
#include <utility>

#include "Configuration/Convert.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationException.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlEmitter.h"
#include "client/ElementText.h"

namespace Configuration {

namespace {

using Client = HttpConfigurationClient;
using Parameters = std::initializer_list<std::pair<const char*, ACE_CString>>;
using WriteRecord = std::function<void(Vesk::XmlEmitter&)>;

const char* const NO_RESPONSE_ELEMENT = "Unable to find response element";
const char* const UNPARSABLE_RESPONSE = "Unable to parse response";

// <Message><operation>parameters, then the record in its wrapper</operation></Message>; empty
// parameters are left out.
ACE_CString requestBody(const char* operation, Parameters parameters, const char* wrapper = nullptr,
                        const char* ns = nullptr, const WriteRecord& record = WriteRecord()) {
    OutputMemStream out;
    Vesk::XmlEmitter xml(out);
    xml.startElement(Client::UWF_MESSAGE);
    xml.startElement(operation);
    for (const auto& parameter : parameters) {
        if (!parameter.second.empty()) {
            xml.textElement(parameter.first, parameter.second);
        }
    }
    if (wrapper != nullptr) {
        Vesk::XmlAttributes attributes;
        attributes.add("xmlns", ns);
        xml.startElement(wrapper, attributes);
        record(xml);
        xml.endElement();
    }
    xml.endElement();
    xml.endElement();
    return ACE_CString(out.data(), out.size());
}

ACE_CString nodeBody(const char* operation, const UwfNodeData& node) {
    return requestBody(operation, {}, "node", UwfNodeData::Namespace(),
                       [&node](Vesk::XmlEmitter& xml) { node.WriteXml(xml); });
}

ACE_CString userBody(const char* operation, const UwfUserData& user) {
    return requestBody(operation, {}, "user", UwfUserData::Namespace(),
                       [&user](Vesk::XmlEmitter& xml) { user.WriteXml(xml); });
}

ACE_CString typeText(UwfNodeData::NodeType type) {
    return type == UwfNodeData::Folder ? "0" : "1";
}

// A "boolean" answer: exactly "true" or "false".
bool booleanAnswer(const ACE_CString& answer) {
    const ACE_CString value = requiredElementText("boolean", answer, NO_RESPONSE_ELEMENT);
    if (value == "true") {
        return true;
    }
    if (value == "false") {
        return false;
    }
    throw HttpConfigurationException(UNPARSABLE_RESPONSE);
}

// Every element tag of answer, in order, loaded into a new record appended to records.
template <class Record>
void collectRecords(const char* tag, const ACE_CString& answer,
                    std::vector<SmartPtr<Record>>& records) {
    ACE_CString text;
    ACE_CString::size_type position = 0;
    while (Client::findElementText(tag, answer, position, text, position)) {
        SmartPtr<Record> record = Record::Create();
        record->LoadXml(text);
        records.push_back(record);
    }
}

}  // namespace

ACE_CString HttpConfigurationClient::sendWorkflow(const ACE_CString& body) const {
    ACE_CString response;
    send(m_workflowUrl, body, response, false);
    return response;
}

ACE_CString HttpConfigurationClient::UwfCreateNode(const UwfNodeData& node,
                                                   BDateTime& lastModified) const {
    const ACE_CString answer = sendWorkflow(nodeBody("CreateNode", node));
    const ACE_CString id = requiredElementText("string", answer, NO_RESPONSE_ELEMENT);
    lastModified = Convert::ToBDateTime(requiredElementText(
        "lastModified", answer, "Unable to find lastModified output parameter"));
    return id;
}

BDateTime HttpConfigurationClient::UwfUpdateNode(const UwfNodeData& node) const {
    const ACE_CString answer = sendWorkflow(nodeBody("UpdateNode", node));
    return Convert::ToBDateTime(requiredElementText("dateTime", answer, NO_RESPONSE_ELEMENT));
}

void HttpConfigurationClient::UwfDeleteNode(const ACE_CString& nodeId, const ACE_CString& userId,
                                            UwfNodeData::NodeType type) const {
    sendWorkflow(requestBody("DeleteNode",
                             {{"nodeId", nodeId}, {"userId", userId}, {"type", typeText(type)}}));
}

void HttpConfigurationClient::UwfInsertExamFolder(const ACE_CString& examKey,
                                                  const ACE_CString& folderId) const {
    sendWorkflow(requestBody("InsertExamFolder", {{"examKey", examKey}, {"folderId", folderId}}));
}

void HttpConfigurationClient::UwfDeleteExamFolder(const ACE_CString& examKey,
                                                  const ACE_CString& folderId) const {
    sendWorkflow(requestBody("DeleteExamFolder", {{"examKey", examKey}, {"folderId", folderId}}));
}

bool HttpConfigurationClient::UwfIsProtectedExam(const ACE_CString& examKey) const {
    return booleanAnswer(sendWorkflow(requestBody("IsProtectedExam", {{"examKey", examKey}})));
}

bool HttpConfigurationClient::UwfIsValidChild(const ACE_CString& id, const ACE_CString& parentId,
                                              UwfNodeData::NodeType type) const {
    return booleanAnswer(sendWorkflow(requestBody(
        "IsValidChild", {{"id", id}, {"parentId", parentId}, {"type", typeText(type)}})));
}

void HttpConfigurationClient::UwfPurgeFolder(const ACE_CString& folderId, int itemsToRetain,
                                             const ACE_CString& userId) const {
    sendWorkflow(requestBody("PurgeFolder", {{"folderId", folderId},
                                             {"itemsToRetain", Convert::ToString(itemsToRetain)},
                                             {"userId", userId}}));
}

void HttpConfigurationClient::UwfGetUserStatus(const ACE_CString& userId, UwfUserData& user) const {
    const ACE_CString answer = sendWorkflow(requestBody("GetUserStatus", {{"userId", userId}}));
    user.LoadXml(requiredElementText("User", answer, UNPARSABLE_RESPONSE));
}

void HttpConfigurationClient::UwfUpdateUserStatus(const UwfUserData& user) const {
    sendWorkflow(userBody("UpdateUserStatus", user));
}

void HttpConfigurationClient::UwfLogoutUser(const ACE_CString& userId) const {
    sendWorkflow(requestBody("Logout", {{"userId", userId}}));
}

void HttpConfigurationClient::UwfDeleteUser(const ACE_CString& userId) const {
    sendWorkflow(requestBody("DeleteUser", {{"userId", userId}}));
}

void HttpConfigurationClient::UwfGetContactNameData(
    const ACE_CString& userId, SmartPtr<UwfContactNameData>& contactName) const {
    const ACE_CString answer = sendWorkflow(requestBody("GetContactName", {{"userId", userId}}));
    contactName = UwfContactNameData::Create();
    ACE_CString text;
    ACE_CString::size_type next = 0;
    if (findElementText("ContactName", answer, 0, text, next)) {
        contactName->LoadXml(text);
    }
}

void HttpConfigurationClient::UwfStorePreference(const ACE_CString& userId, const ACE_CString& path,
                                                 const ACE_CString& data) const {
    sendWorkflow(
        requestBody("StorePreference", {{"userId", userId}, {"path", path}, {"data", data}}));
}

ACE_CString HttpConfigurationClient::UwfRetrievePreference(const ACE_CString& userId,
                                                           const ACE_CString& path) const {
    const ACE_CString answer =
        sendWorkflow(requestBody("RetrievePreference", {{"userId", userId}, {"path", path}}));
    const ACE_CString inner =
        requiredElementText("RetrievePreferenceResponse", answer, NO_RESPONSE_ELEMENT);
    return requiredElementText("string", inner, NO_RESPONSE_ELEMENT);
}

ACE_CString HttpConfigurationClient::UwfRetrieveAllPreferences(const ACE_CString& userIds) const {
    const ACE_CString answer =
        sendWorkflow(requestBody("RetrievePreferences", {{"userIds", userIds}}));
    return requiredElementText("RetrievePreferencesResponse", answer, NO_RESPONSE_ELEMENT);
}

void HttpConfigurationClient::UwfGetFolderData(const ACE_CString& folderId,
                                               const BDateTime& modifiedSince,
                                               std::vector<SmartPtr<UwfNodeData>>& nodes) const {
    const ACE_CString answer = sendWorkflow(requestBody(
        "GetFolderData",
        {{"folderId", folderId}, {"modifiedSince", Convert::ToDotNetDateTime(modifiedSince)}}));
    collectRecords("Node", answer, nodes);
}

void HttpConfigurationClient::UwfLoginUser(const UwfUserData& user,
                                           std::vector<SmartPtr<UwfNodeData>>& nodes) const {
    collectRecords("Node", sendWorkflow(userBody("Login", user)), nodes);
}

void HttpConfigurationClient::UwfListUsers(const ACE_CString& type, bool loggedInOnly,
                                           std::vector<SmartPtr<UwfUserData>>& users) const {
    const ACE_CString answer = sendWorkflow(
        requestBody("ListUsers",
                    {{"type", type}, {"loggedInOnly", Convert::ToStringForDataSet(loggedInOnly)}}));
    collectRecords("User", answer, users);
}

}  // namespace Configuration
