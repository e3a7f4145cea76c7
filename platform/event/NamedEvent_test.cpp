#include "Common/NamedEvent.h"

#include <ace/Event_Handler.h>
#include <ace/Reactor.h>
#include <ace/Time_Value.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <stdexcept>
#include <string>

#include "Quorvex/Machine.h"
#include "testing/FakeMachine.h"
#include "testing/ScratchDir.h"

namespace {

using Quorvex::Testing::FakeMachine;
using Quorvex::Testing::ScratchDir;

const char* const kChangeEvent = "Global\\QuorvexSlaveConfigurationChanged";
// Generous bound for a wake-up that is already queued; never reached when things work.
const int kWaitMs = 5000;

std::string str(const ACE_CString& s) {
    return std::string(s.c_str(), s.length());
}

// Every test gets its own event directory, i.e. its own "machine".
class NamedEventTest : public ::testing::Test {
protected:
    NamedEventTest() : m_scope(m_fake) { m_fake.env["QUORVEX_EVENT_DIR"] = m_dir.path(); }

    ScratchDir m_dir;
    FakeMachine m_fake;
    Quorvex::ScopedMachine m_scope;
};

TEST_F(NamedEventTest, FileNameIsSafe) {
    EXPECT_EQ(m_dir.path(), str(Common::NamedEvent::directory()));
    Common::NamedEvent change(kChangeEvent);
    EXPECT_EQ(m_dir.file("QuorvexSlaveConfigurationChanged"), str(change.path()));
    EXPECT_EQ(kChangeEvent, str(change.name()));

    Common::NamedEvent climbing("../x/..");
    EXPECT_EQ(m_dir.file("%2E.%2Fx%2F.."), str(climbing.path()));
    Common::NamedEvent dots("..");
    EXPECT_EQ(m_dir.file("%2E."), str(dots.path()));
    Common::NamedEvent percent("Local\\50% a");
    EXPECT_EQ(m_dir.file("50%25%20a"), str(percent.path()));
}

TEST_F(NamedEventTest, EmptyNameIsRefused) {
    EXPECT_THROW(Common::NamedEvent(""), std::runtime_error);
    EXPECT_THROW(Common::NamedEvent("Global\\"), std::runtime_error);
}

TEST_F(NamedEventTest, SetWakesEveryHolderAndResetClearsOnlyItsOwn) {
    Common::NamedEvent first(kChangeEvent);
    Common::NamedEvent second(kChangeEvent);
    ASSERT_EQ(0, second.set());
    EXPECT_TRUE(first.wait(kWaitMs));
    EXPECT_TRUE(second.wait(kWaitMs));
    // A pending wake-up stays until reset.
    EXPECT_TRUE(first.wait(0));

    EXPECT_EQ(0, first.reset());
    EXPECT_FALSE(first.wait(0));
    EXPECT_TRUE(second.wait(0));
    EXPECT_EQ(0, second.reset());
    EXPECT_FALSE(second.wait(0));
}

TEST_F(NamedEventTest, RepeatedSetsNeedOneReset) {
    Common::NamedEvent event(kChangeEvent);
    for (int i = 0; i < 50; ++i) {
        ASSERT_EQ(0, event.set());
    }
    EXPECT_TRUE(event.wait(kWaitMs));
    EXPECT_EQ(0, event.reset());
    EXPECT_FALSE(event.wait(0));
}

TEST_F(NamedEventTest, DifferentNamesAreIndependent) {
    Common::NamedEvent change(kChangeEvent);
    Common::NamedEvent other("Global\\SomethingElse");
    ASSERT_EQ(0, other.set());
    EXPECT_TRUE(other.wait(kWaitMs));
    EXPECT_FALSE(change.wait(0));
}

TEST_F(NamedEventTest, DifferentDirectoriesAreIsolated) {
    Common::NamedEvent here(kChangeEvent);
    ScratchDir otherDir;
    FakeMachine otherMachine;
    otherMachine.env["QUORVEX_EVENT_DIR"] = otherDir.path();
    Quorvex::ScopedMachine otherScope(otherMachine);
    Common::NamedEvent there(kChangeEvent);
    ASSERT_EQ(0, there.set());
    EXPECT_TRUE(there.wait(kWaitMs));
    EXPECT_FALSE(here.wait(0));
}

TEST_F(NamedEventTest, MissingDirectoryIsCreatedPrivate) {
    const std::string nested = m_dir.file("events");
    m_fake.env["QUORVEX_EVENT_DIR"] = nested;
    Common::NamedEvent event(kChangeEvent);
    struct stat info {};
    ASSERT_EQ(0, stat(nested.c_str(), &info));
    EXPECT_TRUE(S_ISDIR(info.st_mode));
    EXPECT_EQ(0700u, info.st_mode & 0777u);
}

TEST_F(NamedEventTest, DirectoryFallsBackToRuntimeDirThenTmp) {
    m_fake.env.erase("QUORVEX_EVENT_DIR");
    m_fake.inheritEnvironment = false;
    m_fake.env["XDG_RUNTIME_DIR"] = "/run/user/1234";
    EXPECT_EQ("/run/user/1234/quorvex-events", str(Common::NamedEvent::directory()));
    m_fake.env.erase("XDG_RUNTIME_DIR");
    EXPECT_EQ("/tmp/quorvex-events-" + std::to_string(geteuid()),
              str(Common::NamedEvent::directory()));
}

// Counts wake-ups delivered by the reactor and clears the event, as the repository does; the first
// wake-up ends the event loop.
class WakeCounter : public ACE_Event_Handler {
public:
    explicit WakeCounter(Common::NamedEvent& event) : m_event(event) {}
    int handle_input(ACE_HANDLE) override {
        ++wakeUps;
        m_event.reset();
        reactor()->end_reactor_event_loop();
        return 0;
    }
    int wakeUps = 0;

private:
    Common::NamedEvent& m_event;
};

TEST_F(NamedEventTest, ReactorDeliversTheEvent) {
    Common::NamedEvent listening(kChangeEvent);
    Common::NamedEvent signalling(kChangeEvent);
    WakeCounter handler(listening);
    ACE_Reactor reactor;
    ASSERT_EQ(0,
              reactor.register_handler(listening.handle(), &handler, ACE_Event_Handler::READ_MASK));
    ACE_Time_Value idle(0, 20 * 1000);
    reactor.handle_events(idle);
    EXPECT_EQ(0, handler.wakeUps);  // opening the signalling event woke nobody

    ASSERT_EQ(0, signalling.set());
    ACE_Time_Value bound(kWaitMs / 1000);
    reactor.run_reactor_event_loop(bound);
    EXPECT_EQ(1, handler.wakeUps);

    // handle_input reset the event, so the reactor has nothing more to deliver.
    reactor.reset_reactor_event_loop();
    ACE_Time_Value after(0, 20 * 1000);
    reactor.handle_events(after);
    EXPECT_EQ(1, handler.wakeUps);

    reactor.remove_handler(listening.handle(),
                           ACE_Event_Handler::READ_MASK | ACE_Event_Handler::DONT_CALL);
}

}  // namespace
