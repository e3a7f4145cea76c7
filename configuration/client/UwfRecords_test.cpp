// The user-workflow records and Convert: what a record writes (empty fields and the service's
// fields left out), how it reads the service's texts (UTF-8 names, flags, times, missing
// elements), and the value conversions.
#include <gtest/gtest.h>

#include <functional>
#include <stdexcept>

#include "Configuration/Convert.h"
#include "Configuration/UwfContactNameData.h"
#include "Configuration/UwfNodeData.h"
#include "Configuration/UwfUserData.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlEmitter.h"

namespace Configuration {
namespace {

std::string str(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

template <class Record>
std::string written(const Record& record) {
    OutputMemStream out;
    Vesk::XmlEmitter xml(out);
    record.WriteXml(xml);
    return std::string(out.data(), out.size());
}

TEST(UwfRecords, WriteLeavesOutEmptyFieldsAndTheServicesFields) {
    auto node = UwfNodeData::Create();
    EXPECT_EQ("<Node><Type>0</Type><Shared>false</Shared></Node>", written(*node));
    node->Id = "n1";
    node->UserId = "u<1>";
    node->Type = UwfNodeData::Item;
    node->Shared = true;
    node->ModifiedDateTime = BDateTime("2010-03-04T05:06:07");
    node->SubFolders = 3;
    node->SubItems = 4;
    node->OpaqueData = "a&b";
    EXPECT_EQ(
        "<Node><Id>n1</Id><UserId>u&lt;1&gt;</UserId><Type>1</Type><Shared>true</Shared>"
        "<OpaqueData>a&amp;b</OpaqueData></Node>",
        written(*node));

    auto user = UwfUserData::Create();
    EXPECT_EQ("<User><OnCall>false</OnCall></User>", written(*user));
    user->UserId = "u1";
    user->UserName = "Doe^Jane";
    user->Type = "Radiologist";
    user->InboxId = "i";
    user->MasterFolderId = "m";
    user->OnCall = true;
    EXPECT_EQ(
        "<User><UserId>u1</UserId><UserName>Doe^Jane</UserName><Type>Radiologist</Type>"
        "<InboxId>i</InboxId><MasterFolderId>m</MasterFolderId><OnCall>true</OnCall></User>",
        written(*user));

    auto contact = UwfContactNameData::Create();
    EXPECT_EQ("<ContactName></ContactName>", written(*contact));
    contact->FamilyName = "Doe";
    contact->HonorificSuffix = "MD";
    EXPECT_EQ(
        "<ContactName><FamilyName>Doe</FamilyName><HonorificSuffix>MD</HonorificSuffix>"
        "</ContactName>",
        written(*contact));
}

TEST(UwfRecords, NodeReadsTheServicesText) {
    auto node = UwfNodeData::Create();
    node->OpaqueData = "kept";
    node->LoadXml(
        "<Node><Id>n&amp;1</Id><Name>M\xc3\xbcller</Name><UserId>\xe2\x82\xac</UserId>"
        "<ParentId>p</ParentId><Type>1</Type><Shared>1</Shared>"
        "<ModifiedDateTime>2010-03-04T05:06:07.0890000Z</ModifiedDateTime>"
        "<SubFolders>2</SubFolders><SubItems>x</SubItems></Node>");
    EXPECT_EQ("n&1", str(node->Id));
    EXPECT_EQ("M\xfcller", str(node->Name));  // UTF-8 to Latin-1
    EXPECT_EQ("?", str(node->UserId));        // not in Latin-1
    EXPECT_EQ("p", str(node->ParentId));
    EXPECT_EQ(UwfNodeData::Item, node->Type);
    EXPECT_TRUE(node->Shared);
    EXPECT_EQ(BDateTime("2010-03-04T05:06:07.089"), node->ModifiedDateTime);
    EXPECT_EQ(2, node->SubFolders);
    EXPECT_EQ(0, node->SubItems);
    EXPECT_EQ("kept", str(node->OpaqueData));  // missing element: unchanged
}

TEST(UwfRecords, FlagsOtherThanTrueFalseOneZeroAreRefused) {
    const std::pair<const char*, bool> accepted[] = {{"true", true},   {"TRUE", true},
                                                     {"1", true},      {"false", false},
                                                     {"False", false}, {"0", false}};
    for (const auto& c : accepted) {
        auto user = UwfUserData::Create();
        user->OnCall = !c.second;
        user->LoadXml((std::string("<User><OnCall>") + c.first + "</OnCall></User>").c_str());
        EXPECT_EQ(c.second, user->OnCall) << c.first;
    }
    for (const char* refused : {"yes", "", " true", "2"}) {
        auto node = UwfNodeData::Create();
        try {
            node->LoadXml((std::string("<Shared>") + refused + "</Shared>").c_str());
            ADD_FAILURE() << refused;
        } catch (const std::exception& e) {
            EXPECT_STREQ("Convert::ToBoolean: Unrecognized value", e.what());
        }
    }
}

TEST(UwfRecords, UserAndContactNameConvertWhatTheTableMarks) {
    auto user = UwfUserData::Create();
    user->LoadXml(
        "<User><UserId>J\xc3\xb6rg</UserId><UserName>\xc3\x85sa</UserName>"
        "<Type>T\xc3\xa9</Type><InboxId>i</InboxId><MasterFolderId>m</MasterFolderId></User>");
    EXPECT_EQ("J\xf6rg", str(user->UserId));
    EXPECT_EQ("\xc5sa", str(user->UserName));
    EXPECT_EQ("T\xc3\xa9", str(user->Type));  // read as it stands
    EXPECT_EQ("i", str(user->InboxId));
    EXPECT_EQ("m", str(user->MasterFolderId));

    auto contact = UwfContactNameData::Create();
    contact->LoadXml(
        "<ContactName><FamilyName>G\xc3\xbcnther</FamilyName><GivenName>A</GivenName>"
        "<MiddleName>B</MiddleName><HonorificPrefix>Dr.</HonorificPrefix>"
        "<HonorificSuffix>PhD</HonorificSuffix></ContactName>");
    EXPECT_EQ("G\xfcnther", str(contact->FamilyName));
    EXPECT_EQ("A", str(contact->GivenName));
    EXPECT_EQ("B", str(contact->MiddleName));
    EXPECT_EQ("Dr.", str(contact->HonorificPrefix));
    EXPECT_EQ("PhD", str(contact->HonorificSuffix));
}

TEST(UwfRecords, DataSetNamesAndNamespaces) {
    EXPECT_STREQ("NodeDataSet", UwfNodeData::DataSetName());
    EXPECT_STREQ("UserDataSet", UwfUserData::DataSetName());
    EXPECT_STREQ("ContactNameDataSet", UwfContactNameData::DataSetName());
    const std::pair<std::string, std::string> uris[] = {
        {UwfNodeData::Namespace(), "/UserWorkFlow/Node"},
        {UwfUserData::Namespace(), "/UserWorkFlow/User"},
        {UwfContactNameData::Namespace(), "/UserWorkFlow/ContactName"}};
    for (const auto& uri : uris) {
        EXPECT_EQ(0u, uri.first.find("uri://")) << uri.first;
        EXPECT_EQ(uri.first.size() - uri.second.size(), uri.first.rfind(uri.second)) << uri.first;
    }
}

TEST(Convert, DotNetDateTimeHasSevenFractionDigitsAndAZeroOffset) {
    const std::pair<BDateTime, std::string> cases[] = {
        {BDateTime("2010-03-04T05:06:07.089"), "2010-03-04T05:06:07.0890000-00:00"},
        {BDateTime("1999-12-31T23:59:59.999"), "1999-12-31T23:59:59.9990000-00:00"},
        {BDateTime(BDate(2024, 2, 29), BTime(0, 0, 0)), "2024-02-29T00:00:00.0000000-00:00"},
        {BDateTime(), "0000-00-00T00:00:00.0000000-00:00"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(c.second, str(Convert::ToDotNetDateTime(c.first)));
        if (c.first.isValid()) {
            EXPECT_EQ(c.first, Convert::ToBDateTime(Convert::ToDotNetDateTime(c.first)));
        }
    }
}

TEST(Convert, ToBDateTimeReadsTheServicesForms) {
    const BDateTime expected("2010-03-04T05:06:07.089");
    for (const char* text : {"2010-03-04T05:06:07.0890000-00:00", "2010-03-04T05:06:07.0890000Z",
                             "2010-03-04T05:06:07.089", "2010-03-04T06:06:07.0890000+01:00"}) {
        EXPECT_EQ(expected, Convert::ToBDateTime(text)) << text;
    }
    EXPECT_FALSE(Convert::ToBDateTime("yesterday").isValid());
    EXPECT_FALSE(Convert::ToBDateTime("").isValid());
}

TEST(Convert, NumbersAndFlagsAsText) {
    const std::pair<const char*, int> numbers[] = {
        {"42", 42}, {"-7", -7}, {" 12abc", 12}, {"abc", 0}, {"", 0}};
    for (const auto& n : numbers) {
        EXPECT_EQ(n.second, Convert::ToInt(n.first)) << n.first;
    }
    EXPECT_EQ("-2147483648", str(Convert::ToString(-2147483647 - 1)));
    EXPECT_EQ("true", str(Convert::ToString(true)));
    EXPECT_EQ("false", str(Convert::ToString(false)));
    EXPECT_EQ("true", str(Convert::ToStringForDataSet(true)));
    EXPECT_EQ("false", str(Convert::ToStringForDataSet(false)));
}

}  // namespace
}  // namespace Configuration
