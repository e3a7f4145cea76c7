// KeepAliveTestServer: a raw HTTP/1.1 server on 127.0.0.1 for tests of how clients use their
// connections. It answers every request with the same 200 answer and keeps the connection open
// (keep-alive), so that only the client can end it; it counts the TCP connections it accepted and
// those the client ended. It can stop answering after a number of requests (a hung server). Every
// wait is bounded (polls of 50 ms until stopped), so
// it ends by itself when destroyed. Header-only; for the *_test.cpp files.
#pragma once

#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <atomic>
#include <cstdlib>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace Configuration {
namespace Testing {

// Binds socket to a free port on 127.0.0.1, listens, and returns the port.
inline int listenOnLoopback(int socket, int backlog) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    bind(socket, reinterpret_cast<sockaddr*>(&address), length);
    listen(socket, backlog);
    getsockname(socket, reinterpret_cast<sockaddr*>(&address), &length);
    return ntohs(address.sin_port);
}

class KeepAliveTestServer {
public:
    // answeredRequests: how many requests in all get an answer (the rest are read, never
    // answered); negative for all.
    explicit KeepAliveTestServer(std::string body, int answeredRequests = -1)
        : m_body(std::move(body)), m_answersLeft(answeredRequests) {
        m_listener = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        m_port = listenOnLoopback(m_listener, 16);
        m_acceptor = std::thread([this] { acceptLoop(); });
    }
    ~KeepAliveTestServer() {
        m_stop = true;
        m_acceptor.join();
        for (std::thread& connection : m_connections) {
            connection.join();
        }
        close(m_listener);
    }
    KeepAliveTestServer(const KeepAliveTestServer&) = delete;
    KeepAliveTestServer& operator=(const KeepAliveTestServer&) = delete;

    std::string authority() const { return "127.0.0.1:" + std::to_string(m_port); }
    // TCP connections accepted so far.
    int accepted() const { return m_accepted; }
    // Requests read so far (answered or not).
    int requests() const { return m_requests; }
    // Connections the client closed (the server never closes one while running).
    int endedByClient() const { return m_endedByClient; }

private:
    // Whether fd becomes readable within one poll interval.
    static bool readable(int fd) {
        pollfd entry{fd, POLLIN, 0};
        return poll(&entry, 1, 50) > 0;
    }

    void acceptLoop() {
        while (!m_stop) {
            if (!readable(m_listener)) {
                continue;
            }
            const int fd = accept4(m_listener, nullptr, nullptr, SOCK_CLOEXEC);
            if (fd >= 0) {
                ++m_accepted;
                m_connections.emplace_back([this, fd] { serve(fd); });
            }
        }
    }

    void serve(int fd) {
        std::string pending;
        while (!m_stop) {
            std::size_t bodyStart = 0;
            std::size_t bodyLength = 0;
            while (!complete(pending, bodyStart, bodyLength)) {
                if (!readMore(fd, pending)) {
                    close(fd);
                    return;
                }
            }
            pending.erase(0, bodyStart + bodyLength);
            ++m_requests;
            if (m_answersLeft.fetch_sub(1) == 0) {  // hung: read, never answer
                m_answersLeft = 0;
                continue;
            }
            answer(fd);
        }
        close(fd);
    }

    // Reads what has arrived; false at the end of the connection or when stopped.
    bool readMore(int fd, std::string& pending) {
        while (!m_stop) {
            if (!readable(fd)) {
                continue;
            }
            char buffer[4096];
            const ssize_t count = read(fd, buffer, sizeof buffer);
            if (count <= 0) {
                ++m_endedByClient;
                return false;
            }
            pending.append(buffer, static_cast<std::size_t>(count));
            return true;
        }
        return false;
    }

    // Whether pending holds a whole request (head and Content-Length bytes of body).
    static bool complete(const std::string& pending, std::size_t& bodyStart,
                         std::size_t& bodyLength) {
        const std::size_t headEnd = pending.find("\r\n\r\n");
        if (headEnd == std::string::npos) {
            return false;
        }
        const std::size_t field = pending.find("Content-Length: ");
        bodyLength = field < headEnd ? std::strtoul(pending.c_str() + field + 16, nullptr, 10) : 0;
        bodyStart = headEnd + 4;
        return pending.size() >= bodyStart + bodyLength;
    }

    void answer(int fd) {
        const std::string text = "HTTP/1.1 200 OK\r\nContent-Type: text/xml\r\nContent-Length: " +
                                 std::to_string(m_body.size()) + "\r\n\r\n" + m_body;
        std::size_t sent = 0;
        while (sent < text.size()) {
            const ssize_t count = send(fd, text.data() + sent, text.size() - sent, MSG_NOSIGNAL);
            if (count <= 0) {
                return;
            }
            sent += static_cast<std::size_t>(count);
        }
    }

    const std::string m_body;
    std::atomic<int> m_answersLeft;
    int m_listener = -1;
    int m_port = 0;
    std::atomic<bool> m_stop{false};
    std::atomic<int> m_accepted{0};
    std::atomic<int> m_requests{0};
    std::atomic<int> m_endedByClient{0};
    std::thread m_acceptor;
    std::vector<std::thread> m_connections;  // touched by the acceptor, then by the destructor
};

}  // namespace Testing
}  // namespace Configuration
