// RecordingHttpServer: a real HTTP (or HTTPS) server for tests and benchmarks, bound only to
// 127.0.0.1 on an ephemeral port. It records every request (method, target, headers, cookies,
// body) and answers with scripted responses: a responder function, standing answers chosen by the
// exact request body, a queue of one-shot answers, then a default. A scripted answer can also
// close the connection without answering, or wait a bounded time first.
//
// The server runs on its own threads from construction to destruction; every public method is
// thread-safe. Recorded requests are returned as copies.
#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Quorvex {
namespace Testing {

// One request as the server received it.
struct RecordedRequest {
    std::string method;
    std::string target;  // the request target as sent ("/path?query")
    std::string path;    // the target's path
    std::vector<std::pair<std::string, std::string>> headers;
    std::map<std::string, std::string> cookies;  // parsed from the Cookie header(s)
    std::string body;

    // The first value of a header (name compared ignoring case); empty when absent.
    std::string header(const std::string& name) const;
    // How many times a header was sent.
    std::size_t headerCount(const std::string& name) const;
};

// One scripted answer.
struct ScriptedResponse {
    int status = 200;
    std::string body;
    std::string contentType = "text/xml";
    bool closeWithoutAnswer = false;  // drop the connection instead of answering
    int delayMilliseconds = 0;        // wait before answering (keep it short)

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
    using Responder = std::function<ScriptedResponse(const RecordedRequest&)>;

    // Plain HTTP; listening when the constructor returns.
    RecordingHttpServer();
    // HTTPS with the given identity; listening when the constructor returns.
    explicit RecordingHttpServer(const TlsIdentity& identity);
    // Stops listening and waits for the server's threads.
    ~RecordingHttpServer();
    RecordingHttpServer(const RecordingHttpServer&) = delete;
    RecordingHttpServer& operator=(const RecordingHttpServer&) = delete;

    // The port it listens on.
    int port() const;
    // "127.0.0.1:<port>".
    std::string authority() const;

    // Answers every request whose body is exactly body with response.
    void answerBody(const std::string& body, const ScriptedResponse& response);
    // Queues a one-shot answer for a request that no standing answer matched.
    void enqueue(const ScriptedResponse& response);
    // The answer when nothing else applies (initially 200 with an empty body).
    void setDefault(const ScriptedResponse& response);
    // Decides every answer itself (standing answers, queue and default are then unused).
    void setResponder(Responder responder);
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
    class Impl;
    std::unique_ptr<Impl> m_impl;
};

}  // namespace Testing
}  // namespace Quorvex
