// The user-workflow records: writing and reading their fields.
#include "Configuration/Convert.h"
#include "Configuration/UwfContactNameData.h"
#include "Configuration/UwfNodeData.h"
#include "Configuration/UwfUserData.h"
#include "client/UwfFields.h"

namespace Configuration {

namespace {

// The records' namespaces share one fixed host: the URIs name the record types, they are never
// fetched.
#define UWF_NAMESPACE_BASE "uri://userworkflow.quorvex.local/UserWorkFlow/"

UwfNodeData::NodeType toNodeType(const ACE_CString& text) {
    return static_cast<UwfNodeData::NodeType>(Convert::ToInt(text));
}

}  // namespace

SmartPtr<UwfNodeData> UwfNodeData::Create() {
    return SmartPtr<UwfNodeData>(new UwfNodeData());
}

void UwfNodeData::WriteXml(Vesk::XmlEmitter& xml) const {
    xml.startElement("Node");
    UwfFields::write(xml, "Id", Id);
    UwfFields::write(xml, "Name", Name);
    UwfFields::write(xml, "UserId", UserId);
    UwfFields::write(xml, "ParentId", ParentId);
    UwfFields::write(xml, "Type", Convert::ToString(static_cast<int>(Type)));
    UwfFields::write(xml, "Shared", Convert::ToStringForDataSet(Shared));
    UwfFields::write(xml, "OpaqueData", OpaqueData);
    xml.endElement();
}

void UwfNodeData::LoadXml(const ACE_CString& text) {
    UwfFields::read(text, "Id", Id);
    UwfFields::readUtf8(text, "Name", Name);
    UwfFields::readUtf8(text, "UserId", UserId);
    UwfFields::read(text, "ParentId", ParentId);
    UwfFields::readAs(text, "Type", Type, toNodeType);
    UwfFields::readAs(text, "Shared", Shared, Convert::ToBoolean);
    UwfFields::readAs(text, "ModifiedDateTime", ModifiedDateTime, Convert::ToBDateTime);
    UwfFields::readAs(text, "SubFolders", SubFolders, Convert::ToInt);
    UwfFields::readAs(text, "SubItems", SubItems, Convert::ToInt);
    UwfFields::read(text, "OpaqueData", OpaqueData);
}

const char* UwfNodeData::DataSetName() {
    return "NodeDataSet";
}

const char* UwfNodeData::Namespace() {
    return UWF_NAMESPACE_BASE "Node";
}

SmartPtr<UwfUserData> UwfUserData::Create() {
    return SmartPtr<UwfUserData>(new UwfUserData());
}

void UwfUserData::WriteXml(Vesk::XmlEmitter& xml) const {
    xml.startElement("User");
    UwfFields::write(xml, "UserId", UserId);
    UwfFields::write(xml, "UserName", UserName);
    UwfFields::write(xml, "Type", Type);
    UwfFields::write(xml, "InboxId", InboxId);
    UwfFields::write(xml, "MasterFolderId", MasterFolderId);
    UwfFields::write(xml, "OnCall", Convert::ToStringForDataSet(OnCall));
    xml.endElement();
}

void UwfUserData::LoadXml(const ACE_CString& text) {
    UwfFields::readUtf8(text, "UserId", UserId);
    UwfFields::readUtf8(text, "UserName", UserName);
    UwfFields::read(text, "Type", Type);
    UwfFields::read(text, "InboxId", InboxId);
    UwfFields::read(text, "MasterFolderId", MasterFolderId);
    UwfFields::readAs(text, "OnCall", OnCall, Convert::ToBoolean);
}

const char* UwfUserData::DataSetName() {
    return "UserDataSet";
}

const char* UwfUserData::Namespace() {
    return UWF_NAMESPACE_BASE "User";
}

SmartPtr<UwfContactNameData> UwfContactNameData::Create() {
    return SmartPtr<UwfContactNameData>(new UwfContactNameData());
}

void UwfContactNameData::WriteXml(Vesk::XmlEmitter& xml) const {
    xml.startElement("ContactName");
    UwfFields::write(xml, "FamilyName", FamilyName);
    UwfFields::write(xml, "GivenName", GivenName);
    UwfFields::write(xml, "MiddleName", MiddleName);
    UwfFields::write(xml, "HonorificPrefix", HonorificPrefix);
    UwfFields::write(xml, "HonorificSuffix", HonorificSuffix);
    xml.endElement();
}

void UwfContactNameData::LoadXml(const ACE_CString& text) {
    UwfFields::readUtf8(text, "FamilyName", FamilyName);
    UwfFields::readUtf8(text, "GivenName", GivenName);
    UwfFields::readUtf8(text, "MiddleName", MiddleName);
    UwfFields::readUtf8(text, "HonorificPrefix", HonorificPrefix);
    UwfFields::readUtf8(text, "HonorificSuffix", HonorificSuffix);
}

const char* UwfContactNameData::DataSetName() {
    return "ContactNameDataSet";
}

const char* UwfContactNameData::Namespace() {
    return UWF_NAMESPACE_BASE "ContactName";
}

}  // namespace Configuration
