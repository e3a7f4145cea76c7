#include "ServerInterop/ServerInteropAPI.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
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
    return isCookieValue(content) ? ServerInteropAPI::TICKET_OK
                                  : ServerInteropAPI::TICKET_MALFORMED;
}

}  // namespace

int ServerInteropAPI::GetQuorvexServiceTicket(ACE_String_Base<char>& ticket) {
    ticket.clear();
    const char* path = ticketFilePath();
    std::string content;
    const int result = readTicket(path, content);
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
