#include "RecordingHttpServer.h"

#include <dirent.h>
#include <httplib.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include <strings.h>
#include <chrono>
#include <cstdlib>
#include <deque>
#include <mutex>
#include <stdexcept>
#include <thread>

namespace Quorvex {
namespace Testing {

namespace {

const int MAX_DELAY_MS = 10000;
const int START_WAIT_STEPS = 500;  // 5 s in steps of 10 ms

std::string trim(const std::string& text) {
    const auto first = text.find_first_not_of(" \t");
    if (first == std::string::npos) {
        return std::string();
    }
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

void parseCookies(const std::string& line, std::map<std::string, std::string>& cookies) {
    std::size_t start = 0;
    while (start <= line.size()) {
        auto end = line.find(';', start);
        if (end == std::string::npos) {
            end = line.size();
        }
        const std::string pair = trim(line.substr(start, end - start));
        const auto equals = pair.find('=');
        if (!pair.empty()) {
            cookies[pair.substr(0, equals)] =
                equals == std::string::npos ? std::string() : pair.substr(equals + 1);
        }
        start = end + 1;
    }
}

RecordedRequest toRecord(const httplib::Request& request) {
    RecordedRequest record;
    record.method = request.method;
    record.target = request.target;
    record.path = request.path;
    record.body = request.body;
    for (const auto& header : request.headers) {
        record.headers.emplace_back(header.first, header.second);
        if (strcasecmp(header.first.c_str(), "Cookie") == 0) {
            parseCookies(header.second, record.cookies);
        }
    }
    return record;
}

int portOf(const sockaddr_storage& address) {
    if (address.ss_family != AF_INET) {
        return -1;
    }
    return ntohs(reinterpret_cast<const sockaddr_in&>(address).sin_port);
}

// The descriptor of this process's connection between the two ports; -1 when not found. The
// HTTP library does not hand out its sockets, so the connection is found by its addresses.
int findConnection(int localPort, int remotePort) {
    DIR* folder = opendir("/proc/self/fd");
    if (folder == nullptr) {
        return -1;
    }
    int found = -1;
    while (dirent* entry = readdir(folder)) {
        const int fd = std::atoi(entry->d_name);
        sockaddr_storage local{};
        sockaddr_storage peer{};
        socklen_t localLength = sizeof local;
        socklen_t peerLength = sizeof peer;
        if (fd > 2 && getsockname(fd, reinterpret_cast<sockaddr*>(&local), &localLength) == 0 &&
            getpeername(fd, reinterpret_cast<sockaddr*>(&peer), &peerLength) == 0 &&
            portOf(local) == localPort && portOf(peer) == remotePort) {
            found = fd;
            break;
        }
    }
    closedir(folder);
    return found;
}

// Ends the connection of request without an answer: the peer sees it closed.
void dropConnection(const httplib::Request& request) {
    int fd = request.ssl != nullptr ? SSL_get_fd(request.ssl) : -1;
    if (fd < 0) {
        fd = findConnection(request.local_port, request.remote_port);
    }
    if (fd >= 0) {
        shutdown(fd, SHUT_RDWR);
    }
}

}  // namespace

std::string RecordedRequest::header(const std::string& name) const {
    for (const auto& entry : headers) {
        if (strcasecmp(entry.first.c_str(), name.c_str()) == 0) {
            return entry.second;
        }
    }
    return std::string();
}

std::size_t RecordedRequest::headerCount(const std::string& name) const {
    std::size_t count = 0;
    for (const auto& entry : headers) {
        count += strcasecmp(entry.first.c_str(), name.c_str()) == 0 ? 1 : 0;
    }
    return count;
}

ScriptedResponse ScriptedResponse::Ok(const std::string& body) {
    return Status(200, body);
}

ScriptedResponse ScriptedResponse::Status(int status, const std::string& body) {
    ScriptedResponse response;
    response.status = status;
    response.body = body;
    return response;
}

ScriptedResponse ScriptedResponse::Close() {
    ScriptedResponse response;
    response.closeWithoutAnswer = true;
    return response;
}

class RecordingHttpServer::Impl {
public:
    explicit Impl(std::unique_ptr<httplib::Server> server) : m_server(std::move(server)) {
        if (!m_server->is_valid()) {
            throw std::runtime_error("RecordingHttpServer: the server could not be set up");
        }
        const auto handler = [this](const httplib::Request& request, httplib::Response& response) {
            handle(request, response);
        };
        m_server->Get(".*", handler).Post(".*", handler).Put(".*", handler);
        m_server->Delete(".*", handler);
        m_port = m_server->bind_to_any_port("127.0.0.1");
        if (m_port <= 0) {
            throw std::runtime_error("RecordingHttpServer: cannot bind 127.0.0.1");
        }
        m_thread = std::thread([this] { m_server->listen_after_bind(); });
        waitUntilRunning();
    }

    ~Impl() {
        waitUntilRunning();
        m_server->stop();
        m_thread.join();
    }

    int port() const { return m_port; }

    void answerBody(const std::string& body, const ScriptedResponse& response) {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_byBody[body] = response;
    }
    void enqueue(const ScriptedResponse& response) {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_queue.push_back(response);
    }
    void setDefault(const ScriptedResponse& response) {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_default = response;
    }
    void setResponder(Responder responder) {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_responder = std::move(responder);
    }
    void setRecording(bool recording) {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_recording = recording;
    }
    std::vector<RecordedRequest> requests() const {
        std::lock_guard<std::mutex> lock(m_mutex);
        return m_requests;
    }
    void clearRequests() {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_requests.clear();
    }

private:
    void waitUntilRunning() const {
        for (int step = 0; step < START_WAIT_STEPS && !m_server->is_running(); ++step) {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
    }

    void handle(const httplib::Request& request, httplib::Response& response) {
        const ScriptedResponse answer = record(toRecord(request));
        if (answer.delayMilliseconds > 0) {
            std::this_thread::sleep_for(
                std::chrono::milliseconds(std::min(answer.delayMilliseconds, MAX_DELAY_MS)));
        }
        if (answer.closeWithoutAnswer) {
            dropConnection(request);
            return;
        }
        response.status = answer.status;
        response.set_content(answer.body, answer.contentType.c_str());
    }

    // Records the request and picks its answer.
    ScriptedResponse record(RecordedRequest&& request) {
        Responder responder;
        {
            std::lock_guard<std::mutex> lock(m_mutex);
            if (!m_responder) {
                ScriptedResponse answer = pick(request);
                keep(std::move(request));
                return answer;
            }
            responder = m_responder;
        }
        ScriptedResponse answer = responder(request);
        std::lock_guard<std::mutex> lock(m_mutex);
        keep(std::move(request));
        return answer;
    }

    // Called with m_mutex held.
    ScriptedResponse pick(const RecordedRequest& request) {
        const auto standing = m_byBody.find(request.body);
        if (standing != m_byBody.end()) {
            return standing->second;
        }
        if (!m_queue.empty()) {
            ScriptedResponse answer = m_queue.front();
            m_queue.pop_front();
            return answer;
        }
        return m_default;
    }

    // Called with m_mutex held.
    void keep(RecordedRequest&& request) {
        if (m_recording) {
            m_requests.push_back(std::move(request));
        }
    }

    std::unique_ptr<httplib::Server> m_server;
    int m_port = 0;
    std::thread m_thread;
    mutable std::mutex m_mutex;
    std::map<std::string, ScriptedResponse> m_byBody;
    std::deque<ScriptedResponse> m_queue;
    ScriptedResponse m_default;
    Responder m_responder;
    bool m_recording = true;
    std::vector<RecordedRequest> m_requests;
};

RecordingHttpServer::RecordingHttpServer()
    : m_impl(std::make_unique<Impl>(std::make_unique<httplib::Server>())) {}

RecordingHttpServer::RecordingHttpServer(const TlsIdentity& identity)
    : m_impl(std::make_unique<Impl>(std::make_unique<httplib::SSLServer>(
          identity.certificateFile.c_str(), identity.privateKeyFile.c_str()))) {}

RecordingHttpServer::~RecordingHttpServer() = default;

int RecordingHttpServer::port() const {
    return m_impl->port();
}

std::string RecordingHttpServer::authority() const {
    return "127.0.0.1:" + std::to_string(port());
}

void RecordingHttpServer::answerBody(const std::string& body, const ScriptedResponse& response) {
    m_impl->answerBody(body, response);
}

void RecordingHttpServer::enqueue(const ScriptedResponse& response) {
    m_impl->enqueue(response);
}

void RecordingHttpServer::setDefault(const ScriptedResponse& response) {
    m_impl->setDefault(response);
}

void RecordingHttpServer::setResponder(Responder responder) {
    m_impl->setResponder(std::move(responder));
}

void RecordingHttpServer::setRecording(bool recording) {
    m_impl->setRecording(recording);
}

std::vector<RecordedRequest> RecordingHttpServer::requests() const {
    return m_impl->requests();
}

std::size_t RecordingHttpServer::requestCount() const {
    return requests().size();
}

std::size_t RecordingHttpServer::countBody(const std::string& body) const {
    std::size_t count = 0;
    for (const auto& request : requests()) {
        count += request.body == body ? 1 : 0;
    }
    return count;
}

RecordedRequest RecordingHttpServer::lastRequest() const {
    const auto all = requests();
    if (all.empty()) {
        throw std::logic_error("RecordingHttpServer: no request recorded");
    }
    return all.back();
}

void RecordingHttpServer::clearRequests() {
    m_impl->clearRequests();
}

}  // namespace Testing
}  // namespace Quorvex
