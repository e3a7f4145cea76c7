// Hostile and malformed requests: each gets a clear error answer and leaves the store unchanged.
#include <gtest/gtest.h>

#include <httplib.h>

#include <filesystem>
#include <map>
#include <tuple>

#include "InProcessService.h"
#include "RawPost.h"
#include "Store/DirectoryStore.h"

namespace ConfigurationService {
namespace {

using ServiceTesting::elementText;
using ServiceTesting::InProcessService;
using ServiceTesting::RawAnswer;

// Every file of the store directory with its size.
std::map<std::string, std::uintmax_t> snapshot(const std::string& directory) {
    std::map<std::string, std::uintmax_t> files;
    for (const auto& entry : std::filesystem::directory_iterator(directory)) {
        files[entry.path().filename().string()] = entry.is_regular_file() ? entry.file_size() : 0;
    }
    return files;
}

// A Store request: host, name and the elements that follow them.
std::string storeBody(const std::string& host, const std::string& name,
                      const std::string& rest = "<Configuration>AA==</Configuration>") {
    return ServiceTesting::itemBody("Store", host, name, rest);
}

class BadInput : public ::testing::Test {
protected:
    BadInput() : service(options()) {
        post(storeBody("h", "kept", "<Configuration>a2VwdA==</Configuration>"));
        before = snapshot(service.storeDirectory());
    }

    static ServiceOptions options() {
        ServiceOptions options;
        options.maxBodyBytes = 4096;
        return options;
    }

    RawAnswer post(const std::string& body) {
        return ServiceTesting::rawPost(service.port(), body, InProcessService::ticketCookie());
    }

    // A refused request: the status, a failure ReturnStatus, the message, and nothing stored.
    void expectRefused(const RawAnswer& answer, int status, const std::string& fragment) {
        EXPECT_EQ(answer.status, status) << answer.body;
        EXPECT_EQ(elementText(answer.body, "ReturnStatus"), "0") << answer.body;
        EXPECT_NE(elementText(answer.body, "ErrorMessage").find(fragment), std::string::npos)
            << answer.body;
        EXPECT_EQ(snapshot(service.storeDirectory()), before);
        EXPECT_EQ(service.server().store().size(), 1u);
    }

    InProcessService service;
    std::map<std::string, std::uintmax_t> before;
};

TEST_F(BadInput, MalformedXmlIsRefused) {
    expectRefused(post("<Store><Host>h</Host>"), 400, "malformed XML");
    expectRefused(post("not xml at all"), 400, "malformed XML");
    expectRefused(post(""), 400, "malformed XML");
    expectRefused(post("<Store></Store><Store></Store>"), 400, "more than one root");
}

TEST_F(BadInput, UnknownRootElementIsRefused) {
    expectRefused(post("<DropEverything><Host>h</Host></DropEverything>"), 400,
                  "unknown operation \"DropEverything\"");
    expectRefused(post("<store><Host>h</Host></store>"), 400, "unknown operation");
}

TEST_F(BadInput, IncompleteOrInvalidParametersAreRefused) {
    const std::tuple<std::string, int, const char*> cases[] = {
        {storeBody("h", "n", ""), 200, "needs the element Configuration"},
        {storeBody("h", "n", "<Configuration>!!not base64!!</Configuration>"), 200,
         "not valid Base64"},
        {storeBody("h", "n",
                   "<Configuration>AA==</Configuration><LastModifiedTime>yesterday"
                   "</LastModifiedTime>"),
         200, "not a date and time"},
        {storeBody("<x>h</x>", "n"), 400, "hold only text"},
        {storeBody("h", ""), 200, "configuration name is empty"},
        {storeBody("*", "n"), 200, "not a host name"}};
    for (const auto& c : cases) {
        expectRefused(post(std::get<0>(c)), std::get<1>(c), std::get<2>(c));
    }
}

TEST_F(BadInput, EntitiesAreNeverExpanded) {
    expectRefused(post("<!DOCTYPE Store [<!ENTITY e SYSTEM \"file:///etc/passwd\">]>" +
                       storeBody("&e;", "n", "")),
                  200, "needs the element Configuration");
}

TEST_F(BadInput, OversizedBodyIsRefusedWith413) {
    expectRefused(post(storeBody("h", "n", std::string(8192, 'A'))), 413,
                  "larger than this service accepts");
}

TEST_F(BadInput, MissingOrWrongTicketIsRefused) {
    for (const std::string& cookie : {std::string(), std::string("OrvelWebApplication=guess"),
                                      std::string("Other=") + InProcessService::kTicket}) {
        expectRefused(ServiceTesting::rawPost(service.port(), storeBody("h", "n"), cookie), 403,
                      "service ticket");
    }
    expectRefused(
        ServiceTesting::rawPost(service.port(), "<ListItems><Host>*</Host></ListItems>", ""), 403,
        "service ticket");
}

// Guards against the HTTP library capping form-encoded bodies at 8 KiB with a misleading 413.
TEST_F(BadInput, BodiesAreReadWhateverTheirDeclaredType) {
    httplib::Client client("127.0.0.1", service.port());
    const std::string body = "<Exists><Host>h</Host><ConfigurationName>" + std::string(3000, 'n') +
                             "</ConfigurationName></Exists>";
    auto result =
        client.Post(ConfigurationServer::kPath, {{"Cookie", InProcessService::ticketCookie()}},
                    body, "application/x-www-form-urlencoded");
    ASSERT_TRUE(result);
    EXPECT_EQ(elementText(result->body, "ConfigurationExists"), "0") << result->body;
}

TEST_F(BadInput, WrongMethodOrPathIsRefused) {
    expectRefused(ServiceTesting::rawPost(service.port(), "<GetHostName></GetHostName>",
                                          InProcessService::ticketCookie(), "/other"),
                  404, "no such service path");
}

// Names that look like paths are ordinary names: stored exactly, always inside the directory.
TEST_F(BadInput, PathLikeNamesNeverLeaveTheStoreDirectory) {
    const std::string parent = std::filesystem::path(service.storeDirectory()).parent_path();
    const auto outside = snapshot(parent);
    for (const char* name : {"..\\..\\x", "../x", "../../etc/x", "/x"}) {
        for (const char* host : {"h", "..", "../h"}) {
            const RawAnswer stored =
                post(storeBody(host, name, "<Configuration>cGF0aA==</Configuration>"));
            EXPECT_EQ(elementText(stored.body, "ReturnStatus"), "1") << stored.body;
            const RawAnswer got =
                post(std::string("<Retrieve><Host>") + host + "</Host><ConfigurationName>" + name +
                     "</ConfigurationName></Retrieve>");
            EXPECT_EQ(elementText(got.body, "Configuration"), "cGF0aA==") << name;
        }
    }
    EXPECT_EQ(snapshot(parent).size(), outside.size());
    for (const auto& entry : std::filesystem::recursive_directory_iterator(parent)) {
        EXPECT_TRUE(entry.path().parent_path() == parent ||
                    entry.path().parent_path() == service.storeDirectory() ||
                    entry.path().parent_path() == service.eventDirectory())
            << entry.path();
    }
}

}  // namespace
}  // namespace ConfigurationService
