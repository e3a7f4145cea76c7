// Common::NamedEvent: a machine-wide event that any process can open by name and set; setting it
// wakes every process that has it open.
//
// On Linux an event is a file in the event directory, watched with inotify: set() rewrites the
// file, which makes every open handle readable; reset() drains this handle's pending wake-ups.
// handle() is the inotify descriptor, so an ACE_Reactor can wait on it for input. The directory
// is $QUORVEX_EVENT_DIR, else $XDG_RUNTIME_DIR/quorvex-events, else /tmp/quorvex-events-<uid>;
// a separate directory makes a separate "machine" (tests run several on one host). Names such as
// "Global\QuorvexSlaveConfigurationChanged" map to safe file names. One object must not be used
// from several threads at once; separate objects for the same name are independent.
#pragma once

#include <ace/SString.h>
#include <ace/os_include/os_fcntl.h>

namespace Common {

class NamedEvent {
public:
    // Opens (creating if needed) the event of that name; throws std::runtime_error on failure.
    explicit NamedEvent(const ACE_CString& name);
    ~NamedEvent();
    NamedEvent(const NamedEvent&) = delete;
    NamedEvent& operator=(const NamedEvent&) = delete;

    // Wakes every process that has the event open (this one included); 0 on success.
    int set();
    // Forgets the wake-ups pending on this handle; 0 on success.
    int reset();
    // Waits up to timeoutMs (negative: forever) for a wake-up; true when one is pending.
    bool wait(int timeoutMs);
    // The descriptor to wait on for input.
    ACE_HANDLE handle() const { return m_inotify; }
    const ACE_CString& name() const { return m_name; }
    // The file that stands for the event.
    const ACE_CString& path() const { return m_path; }

    // The directory in which events live.
    static ACE_CString directory();

private:
    ACE_CString m_name;
    ACE_CString m_path;
    ACE_HANDLE m_inotify;
    int m_watch;
};

}  // namespace Common
