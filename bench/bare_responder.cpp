// bare_responder: the fastest HTTP/1.1 answer we know how to give, for benchmarks to measure the
// configuration service against. It listens on 127.0.0.1, reads each request (head and
// Content-Length body), and answers every one with "200 OK", "Content-Type: text/xml" and the
// fixed body read from a file, keeping the connection open unless the client asks to close.
// One thread per core, each with its own event loop and its own listening socket on the same
// port (SO_REUSEPORT), so no lock or hand-over sits on the path of a request.
//
// Usage: bare_responder --body FILE [--port N] [--port-file FILE] [--threads N]
// Runs until SIGINT or SIGTERM.
#include <signal.h>

#include <boost/asio.hpp>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iostream>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

namespace {

namespace net = boost::asio;
using tcp = net::ip::tcp;

struct Options {
    std::string bodyFile;
    std::string portFile;
    unsigned short port = 0;
    unsigned threads = std::max(1u, std::thread::hardware_concurrency());
};

Options parse(int argc, char** argv) {
    Options o;
    for (int i = 1; i + 1 < argc; i += 2) {
        const std::string key = argv[i];
        const std::string value = argv[i + 1];
        if (key == "--body") {
            o.bodyFile = value;
        } else if (key == "--port-file") {
            o.portFile = value;
        } else if (key == "--port") {
            o.port = static_cast<unsigned short>(std::stoi(value));
        } else if (key == "--threads") {
            o.threads = static_cast<unsigned>(std::max(1, std::stoi(value)));
        } else {
            throw std::invalid_argument("unknown option " + key);
        }
    }
    if (o.bodyFile.empty()) {
        throw std::invalid_argument(
            "usage: bare_responder --body FILE [--port N] "
            "[--port-file FILE] [--threads N]");
    }
    return o;
}

std::string readFile(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    if (!in) {
        throw std::runtime_error("cannot read " + path);
    }
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// The answer, shared read-only by every connection.
struct Answer {
    std::string head;
    std::string headClose;
    std::string body;
};

Answer makeAnswer(std::string body) {
    const std::string common = "HTTP/1.1 200 OK\r\nContent-Type: text/xml\r\nContent-Length: " +
                               std::to_string(body.size()) + "\r\n";
    return Answer{common + "\r\n", common + "Connection: close\r\n\r\n", std::move(body)};
}

bool containsNoCase(const char* begin, const char* end, const char* needle) {
    const std::size_t n = std::strlen(needle);
    for (const char* p = begin; p + n <= end; ++p) {
        if (strncasecmp(p, needle, n) == 0) {
            return true;
        }
    }
    return false;
}

// The Content-Length of a head, 0 when absent.
std::size_t contentLength(const char* begin, const char* end) {
    const char* const key = "\r\ncontent-length:";
    const std::size_t n = std::strlen(key);
    for (const char* p = begin; p + n <= end; ++p) {
        if (strncasecmp(p, key, n) == 0) {
            return std::strtoull(p + n, nullptr, 10);
        }
    }
    return 0;
}

class Connection : public std::enable_shared_from_this<Connection> {
public:
    Connection(tcp::socket socket, const Answer& answer)
        : m_socket(std::move(socket)), m_answer(answer) {
        m_socket.set_option(tcp::no_delay(true));
        m_buffer.resize(64 * 1024);
    }

    void start() { read(); }

private:
    void read() {
        if (handleBuffered()) {
            return;
        }
        if (m_used == m_buffer.size()) {
            m_buffer.resize(m_buffer.size() * 2);
        }
        m_socket.async_read_some(net::buffer(&m_buffer[m_used], m_buffer.size() - m_used),
                                 [self = shared_from_this()](auto error, std::size_t n) {
                                     if (!error) {
                                         self->m_used += n;
                                         self->read();
                                     }
                                 });
    }

    // Answers a complete request in the buffer; false when more bytes are needed.
    bool handleBuffered() {
        const char* begin = m_buffer.data();
        const char* end = begin + m_used;
        const char* headEnd = nullptr;
        for (const char* p = begin; p + 4 <= end; ++p) {
            if (std::memcmp(p, "\r\n\r\n", 4) == 0) {
                headEnd = p + 4;
                break;
            }
        }
        if (headEnd == nullptr) {
            return false;
        }
        const std::size_t total = (headEnd - begin) + contentLength(begin, headEnd);
        if (m_used < total) {
            return false;
        }
        const bool close = containsNoCase(begin, headEnd, "\r\nconnection: close");
        m_buffer.erase(0, total);
        m_used -= total;
        write(close);
        return true;
    }

    void write(bool close) {
        const std::string& head = close ? m_answer.headClose : m_answer.head;
        const std::vector<net::const_buffer> buffers{net::buffer(head), net::buffer(m_answer.body)};
        net::async_write(m_socket, buffers,
                         [self = shared_from_this(), close](auto error, std::size_t) {
                             if (error || close) {
                                 boost::system::error_code ignored;
                                 self->m_socket.shutdown(tcp::socket::shutdown_send, ignored);
                                 return;
                             }
                             self->read();
                         });
    }

    tcp::socket m_socket;
    const Answer& m_answer;
    std::string m_buffer;
    std::size_t m_used = 0;
};

// One event loop with its own listening socket.
class Loop {
public:
    Loop(unsigned short port, const Answer& answer) : m_acceptor(m_context), m_answer(answer) {
        const tcp::endpoint endpoint(net::ip::make_address("127.0.0.1"), port);
        m_acceptor.open(endpoint.protocol());
        m_acceptor.set_option(tcp::acceptor::reuse_address(true));
        const int on = 1;
        ::setsockopt(m_acceptor.native_handle(), SOL_SOCKET, SO_REUSEPORT, &on, sizeof on);
        m_acceptor.bind(endpoint);
        m_acceptor.listen(net::socket_base::max_listen_connections);
        accept();
    }

    unsigned short port() const { return m_acceptor.local_endpoint().port(); }
    void run() { m_context.run(); }
    void stop() { m_context.stop(); }

private:
    void accept() {
        m_acceptor.async_accept([this](auto error, tcp::socket socket) {
            if (!error) {
                std::make_shared<Connection>(std::move(socket), m_answer)->start();
            }
            accept();
        });
    }

    net::io_context m_context{1};
    tcp::acceptor m_acceptor;
    const Answer& m_answer;
};

int serve(const Options& options) {
    const Answer answer = makeAnswer(readFile(options.bodyFile));
    std::vector<std::unique_ptr<Loop>> loops;
    loops.push_back(std::make_unique<Loop>(options.port, answer));
    const unsigned short port = loops.front()->port();
    for (unsigned i = 1; i < options.threads; ++i) {
        loops.push_back(std::make_unique<Loop>(port, answer));
    }
    sigset_t stopSignals;
    sigemptyset(&stopSignals);
    sigaddset(&stopSignals, SIGINT);
    sigaddset(&stopSignals, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &stopSignals, nullptr);
    std::vector<std::thread> threads;
    for (auto& loop : loops) {
        threads.emplace_back([&loop] { loop->run(); });
    }
    if (!options.portFile.empty()) {
        const std::string temp = options.portFile + ".tmp";
        std::ofstream(temp) << port << "\n";
        std::rename(temp.c_str(), options.portFile.c_str());
    } else {
        std::cout << port << std::endl;
    }
    int received = 0;
    sigwait(&stopSignals, &received);
    for (auto& loop : loops) {
        loop->stop();
    }
    for (auto& thread : threads) {
        thread.join();
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    signal(SIGPIPE, SIG_IGN);
    try {
        return serve(parse(argc, argv));
    } catch (const std::exception& e) {
        std::cerr << "bare_responder: " << e.what() << "\n";
        return 1;
    }
}
