// The service ticket: the real libServerInterop.so module, its ticket file, and the cookie that
// HttpConfigurationClient sends with it.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <fcntl.h>

#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <fstream>

#include "Client/ServiceTicketModule.h"
#include "ServerInterop/ServerInteropAPI.h"
#include "client/HttpClientTestSupport.h"
#include "testing/LogCapture.h"
#include "testing/ScratchDir.h"

namespace Configuration {
namespace {

using ServerInterop::ServerInteropAPI;
using Testing::ScriptedResponse;

const char* const TICKET = "Tk-8f1c2e0a9b7d";

// Points the module at a ticket file in a scratch folder for the life of the object.
class TicketFile {
public:
    TicketFile() : m_path(m_folder.file("service-ticket")) {
        setenv(ServerInteropAPI::TICKET_FILE_VARIABLE, m_path.c_str(), 1);
    }
    ~TicketFile() { unsetenv(ServerInteropAPI::TICKET_FILE_VARIABLE); }

    void write(const std::string& content, mode_t mode = 0600) {
        std::ofstream(m_path, std::ios::binary | std::ios::trunc) << content;
        chmod(m_path.c_str(), mode);
    }
    // Sets the file's modification time (whole seconds).
    void setModified(time_t when) {
        const timespec times[2] = {{0, UTIME_OMIT}, {when, 0}};
        ASSERT_EQ(0, utimensat(AT_FDCWD, m_path.c_str(), times, 0));
    }

private:
    Quorvex::Testing::ScratchDir m_folder;
    std::string m_path;
};

int fetch(ACE_CString& ticket) {
    return ServiceTicketModule::process().fetch(ticket);
}

TEST(ServiceTicketModule, ReadsTheTicketWithoutTheLineBreak) {
    TicketFile file;
    file.write(std::string(TICKET) + "\r\n");
    ACE_CString ticket("stale");
    ASSERT_EQ(0, fetch(ticket));
    EXPECT_STREQ(TICKET, ticket.c_str());
}

TEST(ServiceTicketModule, AMissingFileGivesNoTicket) {
    TicketFile file;
    ACE_CString ticket;
    EXPECT_EQ(ServerInteropAPI::TICKET_FILE_MISSING, fetch(ticket));
    EXPECT_TRUE(ticket.empty());
}

// A ticket file that has settled is read once and then only looked at (stat): a rewrite that
// keeps its inode, size, time and mode is not seen; any change of those is.
TEST(ServiceTicketModule, ASettledFileIsReadOnceUntilItChanges) {
    TicketFile file;
    const time_t anHourAgo = std::time(nullptr) - 3600;
    const std::pair<const char*, const char*> steps[] = {
        {"Tk-first-0001", "Tk-first-0001"},   // read and kept
        {"Tk-other-0002", "Tk-first-0001"},   // same inode, size, time: the kept ticket
        {nullptr, "Tk-other-0002"},           // only the time moved: read again
        {"Tk-third-0003!", "Tk-third-0003!"}  // new content and size
    };
    for (const auto& step : steps) {
        if (step.first != nullptr) {
            file.write(step.first);
            file.setModified(anHourAgo);
        } else {
            file.setModified(anHourAgo + 1800);
        }
        ACE_CString ticket;
        ASSERT_EQ(0, fetch(ticket));
        EXPECT_STREQ(step.second, ticket.c_str());
    }
    file.write("Tk-fresh-0004");  // just written: read on every call while it may still change
    for (const char* content : {"Tk-fresh-0004", "Tk-fresh-0005"}) {
        file.write(content);
        ACE_CString ticket;
        ASSERT_EQ(0, fetch(ticket));
        EXPECT_STREQ(content, ticket.c_str());
    }
}

TEST(ServiceTicketModule, RefusesAFileOthersCanRead) {
    TicketFile file;
    for (mode_t mode : {0640, 0604, 0620, 0660}) {
        file.write(TICKET, mode);
        ACE_CString ticket;
        EXPECT_EQ(ServerInteropAPI::TICKET_FILE_INSECURE, fetch(ticket)) << std::oct << mode;
        EXPECT_TRUE(ticket.empty());
    }
}

TEST(ServiceTicketModule, RefusesTextThatCannotBeACookieValue) {
    TicketFile file;
    for (const char* content : {"", "\n", "two words", "a;b=c", "x\ny"}) {
        file.write(content);
        ACE_CString ticket;
        EXPECT_EQ(ServerInteropAPI::TICKET_MALFORMED, fetch(ticket)) << content;
    }
}

TEST(ServiceTicketModule, AMissingModuleOrFunctionIsAnError) {
    const std::pair<const char*, const char*> cases[] = {
        {"/nonexistent/libServerInterop.so",
         "ServerInterop DLL is missing. Unable to get service ticket"},
        {"libz.so.1", "Unable to export GetQuorvexServiceTicket from serverinterop.dll"}};
    for (const auto& c : cases) {
        ServiceTicketModule module({c.first});
        ACE_CString ticket;
        try {
            module.fetch(ticket);
            ADD_FAILURE() << "no exception";
        } catch (const std::exception& e) {
            EXPECT_STREQ(c.second, e.what());
        }
    }
}

TEST(ServiceTicketModule, TheVariableOverridesTheSearch) {
    setenv(ServiceTicketModule::LIBRARY_VARIABLE, "/opt/x/libServerInterop.so", 1);
    EXPECT_EQ(std::vector<std::string>{"/opt/x/libServerInterop.so"},
              ServiceTicketModule::defaultCandidates());
    unsetenv(ServiceTicketModule::LIBRARY_VARIABLE);
    const auto candidates = ServiceTicketModule::defaultCandidates();
    ASSERT_LE(2u, candidates.size());
    for (std::size_t i = 0; i + 1 < candidates.size(); ++i) {
        EXPECT_EQ('/', candidates[i][0]) << candidates[i];
        EXPECT_NE(std::string::npos, candidates[i].rfind("/libServerInterop.so"));
    }
    EXPECT_EQ("libServerInterop.so", candidates.back());
}

class ServiceTicketClient : public Testing::HttpClientTest {
protected:
    HttpConfigurationClient makeTicketClient() {
        HttpConfigurationClient::CookieMap cookies;
        cookies["OrvelWebApplication"] = "from-caller";
        cookies["Lang"] = "de";
        return HttpConfigurationClient(serverText(), true, false, cookies);
    }

    TicketFile m_file;
};

TEST_F(ServiceTicketClient, TheTicketBecomesTheCookieOfEveryRequest) {
    m_file.write(TICKET);
    server().clearRequests();
    makeTicketClient().signalRefresh();
    const auto requests = server().requests();
    ASSERT_EQ(3u, requests.size());  // two host-name look-ups and the signal
    for (const auto& request : requests) {
        EXPECT_EQ(std::string("Lang=de; OrvelWebApplication=") + TICKET, request.header("Cookie"));
    }
}

// A missing or insecure ticket file leaves the caller's cookie; the client goes on.
TEST_F(ServiceTicketClient, WithoutAUsableTicketTheCallersCookieStays) {
    for (const bool present : {false, true}) {
        if (present) {
            m_file.write(TICKET, 0644);
        }
        makeTicketClient().signalRefresh();
        EXPECT_EQ("Lang=de; OrvelWebApplication=from-caller",
                  server().lastRequest().header("Cookie"));
    }
}

TEST_F(ServiceTicketClient, TheTicketNeverReachesTheLog) {
    m_file.write(TICKET);
    Quorvex::Testing::LogCapture capture;
    const HttpConfigurationClient client = makeTicketClient();
    server().enqueue(ScriptedResponse::Close());
    EXPECT_ANY_THROW(client.signalRefresh());
    server().enqueue(
        ScriptedResponse::Ok(Testing::LegacyFailure("<ErrorMessage>x</ErrorMessage>")));
    EXPECT_ANY_THROW(client.signalRefresh());
    EXPECT_FALSE(capture.containsFragment(TICKET));
    EXPECT_FALSE(capture.records().empty());
}

// Runs in a fresh process whose module search is pointed at nothing when the library loads.
void constructClientWithTicket() {
    try {
        HttpConfigurationClient client("127.0.0.1:9", true, false);
    } catch (const std::exception& e) {
        std::fprintf(stderr, "%s\n", e.what());
        std::_Exit(3);
    }
    std::_Exit(0);
}

TEST(ServiceTicketDeathTest, AMissingModuleFailsClientsThatWantATicket) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    setenv(ServiceTicketModule::LIBRARY_VARIABLE, "/nonexistent/libServerInterop.so", 1);
    EXPECT_EXIT(constructClientWithTicket(), ::testing::ExitedWithCode(3),
                "ServerInterop DLL is missing\\. Unable to get service ticket");
    unsetenv(ServiceTicketModule::LIBRARY_VARIABLE);
}

}  // namespace
}  // namespace Configuration
