#include "RecordingHttpServer.h"

#include <dirent.h>
#include <httplib.h>
#include <netinet/in.h>
#include <strings.h>
#include <sys/socket.h>

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <stdexcept>

namespace Quorvex {
namespace Testing {

namespace {

const int MAX_DELAY_MS = 10000;
const int START_WAIT_STEPS = 500;  // 5 s in steps of 10 ms

int portOf(const sockaddr_storage& address) {
    if (address.ss_family != AF_INET) {
        return -1;
    }
    return ntohs(reinterpret_cast<const sockaddr_in&>(address).sin_port);
}

// Shuts down (both ways) the connected sockets of this process whose local and peer ports match
// (a peer port of -1 matches any); the peer sees them closed. The HTTP library does not hand out
// its sockets, so they are found by their ports. Returns after the first match when onlyOne.
void shutdownConnections(int localPort, int peerPort, bool onlyOne) {
    DIR* folder = opendir("/proc/self/fd");
    while (dirent* entry = folder != nullptr ? readdir(folder) : nullptr) {
        const int fd = std::atoi(entry->d_name);
        sockaddr_storage local{};
        sockaddr_storage peer{};
        socklen_t localLength = sizeof local;
        socklen_t peerLength = sizeof peer;
        if (fd > 2 && getsockname(fd, reinterpret_cast<sockaddr*>(&local), &localLength) == 0 &&
            getpeername(fd, reinterpret_cast<sockaddr*>(&peer), &peerLength) == 0 &&
            portOf(local) == localPort && (peerPort < 0 || portOf(peer) == peerPort)) {
            shutdown(fd, SHUT_RDWR);
            if (onlyOne) {
                break;
            }
        }
    }
    if (folder != nullptr) {
        closedir(folder);
    }
}

// Ends the connection of request without an answer (plain or TLS).
void dropConnection(const httplib::Request& request) {
    shutdownConnections(request.local_port, request.remote_port, true);
}

// Waits (bounded) until the server's thread is listening.
void waitUntilRunning(const httplib::Server& server) {
    for (int step = 0; step < START_WAIT_STEPS && !server.is_running(); ++step) {
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
}

}  // namespace

bool IgnoringCase::operator()(const std::string& a, const std::string& b) const {
    return strcasecmp(a.c_str(), b.c_str()) < 0;
}

std::string RecordedRequest::header(const std::string& name) const {
    const auto range = headers.equal_range(name);
    return range.first == range.second ? std::string() : range.first->second;
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

RecordingHttpServer::RecordingHttpServer() : m_server(std::make_unique<httplib::Server>()) {
    start();
}

RecordingHttpServer::RecordingHttpServer(const TlsIdentity& identity)
    : m_server(std::make_unique<httplib::SSLServer>(identity.certificateFile.c_str(),
                                                    identity.privateKeyFile.c_str())) {
    start();
}

RecordingHttpServer::~RecordingHttpServer() {
    waitUntilRunning(*m_server);  // stopping a server not yet listening would not stop it
    m_server->stop();
    // Clients keep their connections open between requests; the server's workers would wait on
    // them for the whole keep-alive time before the server could end.
    shutdownConnections(m_port, -1, false);
    m_thread.join();
}

void RecordingHttpServer::start() {
    if (!m_server->is_valid()) {
        throw std::runtime_error("RecordingHttpServer: the server could not be set up");
    }
    const auto handler = [this](const httplib::Request& request, httplib::Response& response) {
        const ScriptedResponse answer = record(request);
        std::this_thread::sleep_for(
            std::chrono::milliseconds(std::min(answer.delayMilliseconds, MAX_DELAY_MS)));
        if (answer.closeWithoutAnswer) {
            dropConnection(request);
            return;
        }
        response.status = answer.status;
        response.set_content(answer.body, "text/xml");
    };
    m_server->Get(".*", handler).Post(".*", handler).Put(".*", handler).Delete(".*", handler);
    // Answers go out at once on kept-alive connections: without TCP_NODELAY the body, written
    // after the head, would wait for the client's delayed acknowledgement (about 40 ms).
    m_server->set_tcp_nodelay(true);
    m_port = m_server->bind_to_any_port("127.0.0.1");
    if (m_port <= 0) {
        throw std::runtime_error("RecordingHttpServer: cannot bind 127.0.0.1");
    }
    m_thread = std::thread([this] { m_server->listen_after_bind(); });
    waitUntilRunning(*m_server);
}

ScriptedResponse RecordingHttpServer::record(const httplib::Request& request) {
    std::lock_guard<std::mutex> lock(m_mutex);
    if (m_recording) {
        m_requests.push_back(RecordedRequest{request.method,
                                             request.target,
                                             {request.headers.begin(), request.headers.end()},
                                             request.body});
    }
    const auto standing = m_byBody.find(request.body);
    if (standing != m_byBody.end()) {
        return standing->second;
    }
    if (m_queue.empty()) {
        return m_default;
    }
    const ScriptedResponse answer = m_queue.front();
    m_queue.pop_front();
    return answer;
}

std::string RecordingHttpServer::authority() const {
    return "127.0.0.1:" + std::to_string(m_port);
}

void RecordingHttpServer::answerBody(const std::string& body, const ScriptedResponse& response) {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_byBody[body] = response;
}

void RecordingHttpServer::enqueue(const ScriptedResponse& response) {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_queue.push_back(response);
}

void RecordingHttpServer::setDefault(const ScriptedResponse& response) {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_default = response;
}

void RecordingHttpServer::setRecording(bool recording) {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_recording = recording;
}

std::vector<RecordedRequest> RecordingHttpServer::requests() const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_requests;
}

std::size_t RecordingHttpServer::requestCount() const {
    return requests().size();
}

std::size_t RecordingHttpServer::countBody(const std::string& body) const {
    const std::vector<RecordedRequest> all = requests();
    return std::count_if(all.begin(), all.end(),
                         [&](const RecordedRequest& request) { return request.body == body; });
}

RecordedRequest RecordingHttpServer::lastRequest() const {
    const std::vector<RecordedRequest> all = requests();
    if (all.empty()) {
        throw std::logic_error("RecordingHttpServer: no request recorded");
    }
    return all.back();
}

void RecordingHttpServer::clearRequests() {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_requests.clear();
}

}  // namespace Testing
}  // namespace Quorvex
