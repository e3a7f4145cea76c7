// The transport's time-out bounds silence, not the whole exchange: a server that stays silent is
// given up on, a body that keeps moving is not cut however long it takes. libcurl looks at the
// silence about once a second, so the silent cases wait well beyond a second.
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <cctype>
#include <chrono>
#include <string>
#include <thread>

#include "client/HttpTransport.h"
#include "client/KeepAliveTestServer.h"
#include "testing/RecordingHttpServer.h"

namespace Configuration {
namespace {

using Clock = std::chrono::steady_clock;
using Quorvex::Testing::RecordingHttpServer;
using Quorvex::Testing::ScriptedResponse;

// A raw HTTP server on 127.0.0.1 for one request: it reads the body through a small receive
// buffer at a steady rate, like a slow link, then answers 200 "ok". Every wait is bounded, so it
// stops by itself when the client goes away.
class SlowReadingServer {
public:
    explicit SlowReadingServer(double bytesPerSecond)
        : m_listener(socket(AF_INET, SOCK_STREAM, 0)), m_rate(bytesPerSecond) {
        // Set before listen, so that the accepted socket has them: a small receive buffer, and
        // segments of an Ethernet link rather than loopback's 64 KiB, which with so small a
        // window would make the sender wait on its persist timer now and then.
        const int receiveBuffer = 128 * 1024;
        setsockopt(m_listener, SOL_SOCKET, SO_RCVBUF, &receiveBuffer, sizeof receiveBuffer);
        const int segment = 1460;
        setsockopt(m_listener, IPPROTO_TCP, TCP_MAXSEG, &segment, sizeof segment);
        m_port = Testing::listenOnLoopback(m_listener, 1);
        m_thread = std::thread([this] { serveOne(); });
    }
    ~SlowReadingServer() {
        m_thread.join();
        close(m_listener);
    }
    SlowReadingServer(const SlowReadingServer&) = delete;
    SlowReadingServer& operator=(const SlowReadingServer&) = delete;

    std::string authority() const { return "127.0.0.1:" + std::to_string(m_port); }
    // Body bytes read so far.
    std::size_t bodyBytes() const { return m_bodyBytes; }

private:
    static constexpr int WAIT_MS = 5000;

    void serveOne() {
        pollfd incoming{m_listener, POLLIN, 0};
        if (poll(&incoming, 1, WAIT_MS) != 1) {
            return;
        }
        const int fd = accept(m_listener, nullptr, nullptr);
        if (fd < 0) {
            return;
        }
        const timeval wait{WAIT_MS / 1000, 0};
        setsockopt(fd, SOL_SOCKET, SO_RCVTIMEO, &wait, sizeof wait);
        std::string head;
        if (readHead(fd, head) && readBodySlowly(fd, head)) {
            const char answer[] =
                "HTTP/1.1 200 OK\r\nContent-Length: 2\r\nConnection: close\r\n\r\nok";
            send(fd, answer, sizeof answer - 1, MSG_NOSIGNAL);
        }
        close(fd);
    }

    // Reads up to the blank line; what follows it (the start of the body) stays in head.
    static bool readHead(int fd, std::string& head) {
        char buffer[4096];
        while (head.find("\r\n\r\n") == std::string::npos && head.size() < 65536) {
            const ssize_t n = recv(fd, buffer, sizeof buffer, 0);
            if (n <= 0) {
                return false;
            }
            head.append(buffer, static_cast<std::size_t>(n));
        }
        return head.find("\r\n\r\n") != std::string::npos;
    }

    static std::size_t contentLength(std::string head) {
        std::transform(head.begin(), head.end(), head.begin(),
                       [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
        const auto at = head.find("\r\ncontent-length:");
        return at == std::string::npos ? 0 : std::stoul(head.substr(at + 17));
    }

    bool readBodySlowly(int fd, const std::string& head) {
        const std::size_t length = contentLength(head);
        m_bodyBytes = head.size() - (head.find("\r\n\r\n") + 4);
        const Clock::time_point start = Clock::now();
        std::string buffer(64 * 1024, '\0');
        while (m_bodyBytes < length) {
            const ssize_t n = recv(fd, &buffer[0], buffer.size(), 0);
            if (n <= 0) {
                return false;
            }
            m_bodyBytes += static_cast<std::size_t>(n);
            const auto due = start + std::chrono::duration_cast<Clock::duration>(
                                         std::chrono::duration<double>(m_bodyBytes / m_rate));
            std::this_thread::sleep_until(due);
        }
        return true;
    }

    int m_listener;
    int m_port = 0;
    double m_rate;
    std::atomic<std::size_t> m_bodyBytes{0};
    std::thread m_thread;
};

long millisecondsSince(Clock::time_point start) {
    return static_cast<long>(
        std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - start).count());
}

TEST(HttpClientTimeOut, AnAnswerLaterThanTheTimeOutIsNotReceived) {
    RecordingHttpServer server;
    ScriptedResponse late = ScriptedResponse::Ok("late");
    late.delayMilliseconds = 2000;  // silent for well beyond the once-a-second check
    server.enqueue(late);
    HttpTransport::Answer answer;
    const Clock::time_point start = Clock::now();
    EXPECT_EQ(
        HttpTransport::Outcome::NotReceived,
        HttpTransport::post(server.authority().c_str(),
                            ("http://" + server.authority() + "/").c_str(), "x", {}, 100, answer));
    EXPECT_LT(millisecondsSince(start), 2000);  // given up on before the answer came
}

// The body takes about twice the time-out to go up through the server's small buffer, but never
// stops moving for long: the time-out must not cut it. The client's send buffer (growing to a few
// MiB) is drained last, in a small part of the time-out.
TEST(HttpClientTimeOut, AnUploadThatKeepsMovingIsNotCut) {
    const long timeoutMs = 1000;
    const double bytesPerSecond = 12e6;
    const std::string body(24u << 20, 'x');  // about 2.1 s at that rate
    SlowReadingServer server(bytesPerSecond);
    HttpTransport::Answer answer;
    const Clock::time_point start = Clock::now();
    const auto outcome = HttpTransport::post(
        server.authority().c_str(), ("http://" + server.authority() + "/").c_str(),
        ACE_CString(body.data(), body.size()), {}, timeoutMs, answer);
    const long elapsed = millisecondsSince(start);
    ASSERT_EQ(HttpTransport::Outcome::Answered, outcome) << "after " << elapsed << " ms";
    EXPECT_EQ("ok", std::string(answer.body.c_str()));
    EXPECT_EQ(body.size(), server.bodyBytes());
    EXPECT_GT(elapsed, timeoutMs * 3 / 2);  // the exchange really outlasted the time-out
}

}  // namespace
}  // namespace Configuration
