// Common::NamedEvent on Linux: one file per event, watched with inotify for IN_CLOSE_WRITE.
#include "Common/NamedEvent.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstring>
#include <stdexcept>
#include <string>

#include "EventFileName.h"
#include "Quorvex/Host.h"

namespace Common {
namespace {

// The error of the last failed call, described.
std::runtime_error failure(const std::string& what, const ACE_CString& subject) {
    const int error = errno;
    return std::runtime_error("NamedEvent: " + what + " " + subject.c_str() + ": " +
                              std::strerror(error));
}

// The fallback directory under /tmp is shared by everyone: it must be ours, and a real directory.
void checkPrivateDirectory(const ACE_CString& dir) {
    struct stat info {};
    if (lstat(dir.c_str(), &info) != 0) {
        throw failure("cannot inspect", dir);
    }
    if (!S_ISDIR(info.st_mode) || info.st_uid != geteuid()) {
        errno = EPERM;
        throw failure("not a private directory:", dir);
    }
}

ACE_CString defaultDirectory() {
    return ACE_CString("/tmp/quorvex-events-") +
           ACE_CString(std::to_string(static_cast<unsigned long>(geteuid())).c_str());
}

// Creates the directory (0700) unless it exists.
void ensureDirectory(const ACE_CString& dir) {
    if (mkdir(dir.c_str(), 0700) != 0 && errno != EEXIST) {
        throw failure("cannot create directory", dir);
    }
    if (dir == defaultDirectory()) {
        checkPrivateDirectory(dir);
    }
}

// Creates the event file without writing it: a write would wake the other holders.
void ensureFile(const ACE_CString& path) {
    const int fd = open(path.c_str(), O_RDONLY | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0666);
    if (fd < 0) {
        throw failure("cannot create", path);
    }
    close(fd);
}

}  // namespace

ACE_CString NamedEvent::directory() {
    ACE_CString value;
    if (Quorvex::GetEnvironmentVariable("QUORVEX_EVENT_DIR", value) && value.length() > 0) {
        return value;
    }
    if (Quorvex::GetEnvironmentVariable("XDG_RUNTIME_DIR", value) && value.length() > 0) {
        return value + "/quorvex-events";
    }
    return defaultDirectory();
}

NamedEvent::NamedEvent(const ACE_CString& name) : m_name(name), m_inotify(-1), m_watch(-1) {
    const ACE_CString dir = directory();
    m_path = dir + "/" + EventFileName(name);
    ensureDirectory(dir);
    ensureFile(m_path);
    m_inotify = inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
    if (m_inotify < 0) {
        throw failure("inotify_init1 failed for", m_path);
    }
    m_watch = inotify_add_watch(m_inotify, m_path.c_str(), IN_CLOSE_WRITE);
    if (m_watch < 0) {
        const std::runtime_error error = failure("cannot watch", m_path);
        close(m_inotify);
        throw error;
    }
}

NamedEvent::~NamedEvent() {
    close(m_inotify);
}

int NamedEvent::set() {
    const int fd =
        open(m_path.c_str(), O_WRONLY | O_TRUNC | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0666);
    if (fd < 0) {
        return -1;
    }
    const bool written = write(fd, "1", 1) == 1;
    // Closing the written file is what queues IN_CLOSE_WRITE on every watcher.
    const bool closed = close(fd) == 0;
    return written && closed ? 0 : -1;
}

int NamedEvent::reset() {
    alignas(inotify_event) char buffer[4096];
    for (;;) {
        const ssize_t n = read(m_inotify, buffer, sizeof buffer);
        if (n > 0) {
            continue;
        }
        if (n < 0 && errno == EINTR) {
            continue;
        }
        return n < 0 && errno == EAGAIN ? 0 : -1;
    }
}

bool NamedEvent::wait(int timeoutMs) {
    using Clock = std::chrono::steady_clock;
    const Clock::time_point deadline = Clock::now() + std::chrono::milliseconds(timeoutMs);
    pollfd entry{m_inotify, POLLIN, 0};
    int remaining = timeoutMs;
    for (;;) {
        const int ready = poll(&entry, 1, remaining);
        if (ready >= 0) {
            return ready > 0 && (entry.revents & POLLIN) != 0;
        }
        if (errno != EINTR) {
            return false;
        }
        if (timeoutMs >= 0) {
            const auto left =
                std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now());
            remaining = left.count() > 0 ? static_cast<int>(left.count()) : 0;
        }
    }
}

}  // namespace Common
