// Client sockets for tests of the HTTP front.
#include "RawConnection.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>

namespace ServiceTesting {
namespace {

constexpr const char* kPath = "/Sundrel/ConfigurationService/ConfigurationService.ashx";

std::string lower(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

std::string trim(const std::string& text) {
    const std::size_t first = text.find_first_not_of(" \t");
    const std::size_t last = text.find_last_not_of(" \t\r");
    return first == std::string::npos ? std::string() : text.substr(first, last - first + 1);
}

// Parses the head (up to the blank line) into status and fields.
void parseHead(const std::string& head, HttpAnswer& answer) {
    std::size_t start = 0;
    bool first = true;
    while (start < head.size()) {
        std::size_t end = head.find("\r\n", start);
        end = end == std::string::npos ? head.size() : end;
        const std::string line = head.substr(start, end - start);
        if (first) {
            const std::size_t space = line.find(' ');
            answer.status = space == std::string::npos ? -1 : std::atoi(line.c_str() + space + 1);
            first = false;
        } else if (const std::size_t colon = line.find(':'); colon != std::string::npos) {
            answer.fields[lower(trim(line.substr(0, colon)))] = trim(line.substr(colon + 1));
        }
        start = end + 2;
    }
}

}  // namespace

RawConnection::RawConnection(int port) {
    m_fd = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (m_fd < 0) {
        return;
    }
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(static_cast<std::uint16_t>(port));
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    int yes = 1;
    ::setsockopt(m_fd, IPPROTO_TCP, TCP_NODELAY, &yes, sizeof yes);
    if (::connect(m_fd, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
        close();
    }
}

RawConnection::~RawConnection() {
    close();
}

RawConnection::RawConnection(RawConnection&& other) noexcept
    : m_fd(other.m_fd), m_pending(std::move(other.m_pending)) {
    other.m_fd = -1;
}

RawConnection& RawConnection::operator=(RawConnection&& other) noexcept {
    if (this != &other) {
        close();
        m_fd = other.m_fd;
        m_pending = std::move(other.m_pending);
        other.m_fd = -1;
    }
    return *this;
}

void RawConnection::close() {
    if (m_fd >= 0) {
        ::close(m_fd);
        m_fd = -1;
    }
}

bool RawConnection::send(const std::string& bytes) {
    std::size_t sent = 0;
    while (m_fd >= 0 && sent < bytes.size()) {
        const ssize_t n = ::send(m_fd, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
        if (n <= 0) {
            return false;
        }
        sent += static_cast<std::size_t>(n);
    }
    return m_fd >= 0;
}

// Reads what arrives before deadline into m_pending; false when closed, reset or timed out.
bool RawConnection::fill(std::chrono::steady_clock::time_point deadline) {
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
        deadline - std::chrono::steady_clock::now());
    pollfd wait{m_fd, POLLIN, 0};
    if (m_fd < 0 || left.count() <= 0 || ::poll(&wait, 1, static_cast<int>(left.count())) <= 0) {
        return false;
    }
    char chunk[65536];
    const ssize_t n = ::recv(m_fd, chunk, sizeof chunk, 0);
    if (n <= 0) {
        return false;
    }
    m_pending.append(chunk, static_cast<std::size_t>(n));
    return true;
}

HttpAnswer RawConnection::readAnswer(std::chrono::milliseconds timeout) {
    const auto deadline = std::chrono::steady_clock::now() + timeout;
    HttpAnswer answer;
    std::size_t headEnd;
    while ((headEnd = m_pending.find("\r\n\r\n")) == std::string::npos) {
        if (!fill(deadline)) {
            return HttpAnswer{};
        }
    }
    parseHead(m_pending.substr(0, headEnd), answer);
    const std::size_t length = std::stoul("0" + answer.fields["content-length"]);
    while (m_pending.size() < headEnd + 4 + length) {
        if (!fill(deadline)) {
            return HttpAnswer{};
        }
    }
    answer.body = m_pending.substr(headEnd + 4, length);
    m_pending.erase(0, headEnd + 4 + length);
    return answer;
}

bool RawConnection::closedByPeer(std::chrono::milliseconds timeout) {
    const auto deadline = std::chrono::steady_clock::now() + timeout;
    do {
        if (m_fd < 0) {
            return true;
        }
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        pollfd wait{m_fd, POLLIN, 0};
        if (::poll(&wait, 1, static_cast<int>(std::max<long>(0, left.count()))) <= 0) {
            continue;
        }
        char chunk[65536];
        if (::recv(m_fd, chunk, sizeof chunk, 0) <= 0) {
            return true;
        }
    } while (std::chrono::steady_clock::now() < deadline);
    return false;
}

std::string RawConnection::post(const std::string& body, const std::string& cookie,
                                const std::string& extraFields) {
    std::string request = std::string("POST ") + kPath + " HTTP/1.1\r\nHost: 127.0.0.1\r\n";
    if (!cookie.empty()) {
        request += "Cookie: " + cookie + "\r\n";
    }
    request += extraFields;
    request += "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n";
    return request + body;
}

}  // namespace ServiceTesting
