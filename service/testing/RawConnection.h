// RawConnection: one client socket to a service under test on 127.0.0.1, for tests that must
// send exactly what they choose (half a head, one byte at a time, several requests at once,
// nothing at all) and read exactly what comes back. Reads are bounded by a time-out, so a test
// never hangs on a silent server. One object per socket; not thread-safe.
#pragma once

#include <chrono>
#include <map>
#include <string>

namespace ServiceTesting {

// One HTTP answer as read from the socket.
struct HttpAnswer {
    int status = 0;                             // 0: none (closed or timed out)
    std::map<std::string, std::string> fields;  // names in lower case
    std::string body;
};

class RawConnection {
public:
    // Connects to 127.0.0.1:port; a failed connection is reported by isOpen().
    explicit RawConnection(int port);
    ~RawConnection();
    RawConnection(RawConnection&& other) noexcept;
    RawConnection& operator=(RawConnection&& other) noexcept;
    RawConnection(const RawConnection&) = delete;
    RawConnection& operator=(const RawConnection&) = delete;

    // Whether the socket is connected (and not closed by this side).
    bool isOpen() const { return m_fd >= 0; }
    // Sends bytes; false when the peer has closed or reset the connection.
    bool send(const std::string& bytes);
    // Reads one answer (head and Content-Length body) within timeout.
    HttpAnswer readAnswer(std::chrono::milliseconds timeout);
    // Whether the peer closes (or resets) the connection within timeout (0: has closed it), or
    // it never opened; bytes that arrive meanwhile are dropped.
    bool closedByPeer(std::chrono::milliseconds timeout);
    // Closes this side.
    void close();

    // A POST of body to the service path, with the cookie header when cookie is not empty.
    static std::string post(const std::string& body, const std::string& cookie,
                            const std::string& extraFields = std::string());

private:
    bool fill(std::chrono::steady_clock::time_point deadline);

    int m_fd = -1;
    std::string m_pending;  // bytes read but not yet returned
};

}  // namespace ServiceTesting
