// RecordingHttpServer: a real HTTP (or HTTPS) server for tests and benchmarks, bound only to
// 127.0.0.1 on an ephemeral port. It records every request (method, target, headers, body) and
// answers with scripted responses: standing answers chosen by the exact request body, then a queue
// of one-shot answers, then a default. A scripted answer can also close the connection without
// answering, or wait a bounded time first.
//
// The server runs on its own thread from construction to destruction; every public method is
// thread-safe. Recorded requests are returned as copies.
#pragma once

#include <cstddef>
#include <deque>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <utility>
#include <vector>

namespace httplib {
class Server;
struct Request;
}  // namespace httplib

namespace Quorvex {
namespace Testing {

// Orders header names ignoring case.
struct IgnoringCase {
    bool operator()(const std::string& a, const std::string& b) const;
};

// One request as the server received it.
struct RecordedRequest {
    std::string method;
    std::string target;                                             // as sent ("/path?query")
    std::multimap<std::string, std::string, IgnoringCase> headers;  // same name: in order sent
    std::string body;

    // The first value of a header; empty when absent.
    std::string header(const std::string& name) const;
    // How many times a header was sent.
    std::size_t headerCount(const std::string& name) const { return headers.count(name); }
};

// One scripted answer (text/xml).
struct ScriptedResponse {
    int status = 200;
    std::string body;
    bool closeWithoutAnswer = false;  // drop the connection instead of answering
    int delayMilliseconds = 0;        // wait before answering (at most 10 s; keep it short)

    // 200 with body.
    static ScriptedResponse Ok(const std::string& body);
    // Any status with body.
    static ScriptedResponse Status(int status, const std::string& body);
    // Closes the connection without sending anything.
    static ScriptedResponse Close();
};

// A server certificate and its private key (PEM files).
struct TlsIdentity {
    std::string certificateFile;
    std::string privateKeyFile;
};

class RecordingHttpServer {
public:
    // Plain HTTP; listening when the constructor returns.
    RecordingHttpServer();
    // HTTPS with the given identity; listening when the constructor returns.
    explicit RecordingHttpServer(const TlsIdentity& identity);
    // Stops listening and waits for the server's thread.
    ~RecordingHttpServer();
    RecordingHttpServer(const RecordingHttpServer&) = delete;
    RecordingHttpServer& operator=(const RecordingHttpServer&) = delete;

    // The port it listens on.
    int port() const { return m_port; }
    // "127.0.0.1:<port>".
    std::string authority() const;

    // Answers every request whose body is exactly body with response.
    void answerBody(const std::string& body, const ScriptedResponse& response);
    // Queues a one-shot answer for a request that no standing answer matched.
    void enqueue(const ScriptedResponse& response);
    // The answer when nothing else applies (initially 200 with an empty body).
    void setDefault(const ScriptedResponse& response);
    // Stops or resumes recording (answers are still given); for long benchmark runs.
    void setRecording(bool recording);

    // Every request recorded so far, in arrival order.
    std::vector<RecordedRequest> requests() const;
    // How many requests were recorded.
    std::size_t requestCount() const;
    // How many recorded requests had exactly this body.
    std::size_t countBody(const std::string& body) const;
    // The last request recorded; throws std::logic_error when there is none.
    RecordedRequest lastRequest() const;
    // Forgets the recorded requests.
    void clearRequests();

private:
    // Binds the port and starts listening on m_thread.
    void start();
    // Records request (when recording) and picks its answer.
    ScriptedResponse record(const httplib::Request& request);

    std::unique_ptr<httplib::Server> m_server;
    int m_port = 0;
    std::thread m_thread;
    mutable std::mutex m_mutex;  // guards the members below
    std::map<std::string, ScriptedResponse> m_byBody;
    std::deque<ScriptedResponse> m_queue;
    ScriptedResponse m_default;
    bool m_recording = true;
    std::vector<RecordedRequest> m_requests;
};

}  // namespace Testing
}  // namespace Quorvex
