#include "ServerInterop/ServerInteropAPI.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <ctime>
#include <mutex>
#include <string>

#include "Quorvex/Log.h"

namespace ServerInterop {

namespace {

const char* ticketFilePath() {
    const char* path = std::getenv(ServerInteropAPI::TICKET_FILE_VARIABLE);
    return path != nullptr && *path != '\0' ? path : ServerInteropAPI::DEFAULT_TICKET_FILE;
}

// Closes a descriptor when leaving scope.
class FileDescriptor {
public:
    explicit FileDescriptor(int fd) : m_fd(fd) {}
    ~FileDescriptor() {
        if (m_fd >= 0) {
            ::close(m_fd);
        }
    }
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    int get() const { return m_fd; }

private:
    int m_fd;
};

// Only a regular file that nobody but its owner (this user or root) can read or change.
bool isPrivate(const struct stat& status) {
    const bool ownerOk = status.st_uid == ::geteuid() || status.st_uid == 0;
    return S_ISREG(status.st_mode) && (status.st_mode & (S_IRWXG | S_IRWXO)) == 0 && ownerOk;
}

// Reads the whole file; false on an error or when it is longer than the limit.
bool readAll(int fd, std::string& content) {
    char buffer[512];
    for (;;) {
        const ssize_t count = ::read(fd, buffer, sizeof buffer);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count < 0) {
            return false;
        }
        if (count == 0) {
            return true;
        }
        content.append(buffer, static_cast<std::size_t>(count));
        if (content.size() > ServerInteropAPI::MAX_TICKET_LENGTH) {
            return false;
        }
    }
}

// A cookie value's characters: printable ASCII without space, quote, comma, semicolon, backslash.
bool isCookieValue(const std::string& text) {
    for (unsigned char c : text) {
        if (c < 0x21 || c > 0x7e || c == '"' || c == ',' || c == ';' || c == '\\') {
            return false;
        }
    }
    return !text.empty();
}

// What identifies one version of the ticket file: a rewrite, replacement, chmod or chown changes
// at least one of these.
struct FileVersion {
    dev_t device = 0;
    ino_t inode = 0;
    off_t size = 0;
    timespec modified{};
    mode_t mode = 0;
    uid_t owner = 0;

    FileVersion() = default;
    explicit FileVersion(const struct stat& status)
        : device(status.st_dev),
          inode(status.st_ino),
          size(status.st_size),
          modified(status.st_mtim),
          mode(status.st_mode),
          owner(status.st_uid) {}
    bool operator==(const FileVersion& other) const {
        return device == other.device && inode == other.inode && size == other.size &&
               modified.tv_sec == other.modified.tv_sec &&
               modified.tv_nsec == other.modified.tv_nsec && mode == other.mode &&
               owner == other.owner;
    }
};

// A file changed less than this long ago may change again within the file system's clock tick
// without its modification time moving, so its content is not kept.
constexpr time_t kSettledSeconds = 2;

bool hasSettled(const struct stat& status) {
    return status.st_mtim.tv_sec + kSettledSeconds <= std::time(nullptr);
}

// The last good ticket, with the path and file version it was read from, so that asking again
// while the file is unchanged costs a stat instead of reading the file. Process-wide.
class TicketCache {
public:
    // Whether a ticket read from this version of path is held; copies it into ticket.
    bool find(const std::string& path, const FileVersion& version, std::string& ticket) {
        const std::lock_guard<std::mutex> guard(m_mutex);
        if (!m_valid || m_path != path || !(m_version == version)) {
            return false;
        }
        ticket = m_ticket;
        return true;
    }
    void keep(const std::string& path, const FileVersion& version, const std::string& ticket) {
        const std::lock_guard<std::mutex> guard(m_mutex);
        m_valid = true;
        m_path = path;
        m_version = version;
        m_ticket = ticket;
    }
    void forget() {
        const std::lock_guard<std::mutex> guard(m_mutex);
        m_valid = false;
        m_ticket.clear();
    }

private:
    std::mutex m_mutex;
    bool m_valid = false;
    std::string m_path;
    FileVersion m_version;
    std::string m_ticket;
};

TicketCache& ticketCache() {
    static TicketCache* const cache = new TicketCache();  // kept until the process ends
    return *cache;
}

int readTicket(const char* path, std::string& content) {
    FileDescriptor file(::open(path, O_RDONLY | O_CLOEXEC | O_NOCTTY));
    if (file.get() < 0) {
        return errno == ENOENT ? ServerInteropAPI::TICKET_FILE_MISSING
                               : ServerInteropAPI::TICKET_FILE_UNREADABLE;
    }
    struct stat status {};
    if (::fstat(file.get(), &status) != 0) {
        return ServerInteropAPI::TICKET_FILE_UNREADABLE;
    }
    if (!isPrivate(status)) {
        return ServerInteropAPI::TICKET_FILE_INSECURE;
    }
    if (!readAll(file.get(), content)) {
        return ServerInteropAPI::TICKET_FILE_UNREADABLE;
    }
    while (!content.empty() && (content.back() == '\n' || content.back() == '\r')) {
        content.pop_back();
    }
    if (!isCookieValue(content)) {
        return ServerInteropAPI::TICKET_MALFORMED;
    }
    if (hasSettled(status)) {
        ticketCache().keep(path, FileVersion(status), content);
    }
    return ServerInteropAPI::TICKET_OK;
}

// The ticket of path: from the cache while the file is the version it was read from, else read.
int currentTicket(const char* path, std::string& content) {
    struct stat status {};
    if (::stat(path, &status) == 0 && ticketCache().find(path, FileVersion(status), content)) {
        return ServerInteropAPI::TICKET_OK;
    }
    ticketCache().forget();
    return readTicket(path, content);
}

}  // namespace

int ServerInteropAPI::GetQuorvexServiceTicket(ACE_String_Base<char>& ticket) {
    ticket.clear();
    const char* path = ticketFilePath();
    std::string content;
    const int result = currentTicket(path, content);
    if (result != TICKET_OK) {
        // Names the file and the reason only; the content never reaches a log.
        QUORVEX_LOG(LM_DEBUG,
                    "ServerInteropAPI::GetQuorvexServiceTicket: no ticket from %s (reason %d)\n",
                    path, result);
        return result;
    }
    ticket.set(content.data(), content.size(), true);
    return TICKET_OK;
}

}  // namespace ServerInterop
