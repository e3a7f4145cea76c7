#include "client/HttpTransport.h"

#include <curl/curl.h>
#include <pthread.h>

#include <atomic>
#include <chrono>
#include <cstdlib>
#include <string>

#include "Quorvex/Log.h"
#include "client/HttpRoute.h"

namespace Configuration {

namespace {

// libcurl's global set-up, done exactly once per process before the first handle.
void initialiseCurl() {
    static const CURLcode result = curl_global_init(CURL_GLOBAL_DEFAULT);
    (void)result;
}

// Counts the forks this process came out of. A forked child must not use its parent's easy handle
// (its internal state belongs to the parent), so on the first post after a fork the child makes
// its own and leaves the parent's untouched.
std::atomic<unsigned> g_forkGeneration{0};

void countFork() {
    g_forkGeneration.fetch_add(1, std::memory_order_relaxed);
}

unsigned forkGeneration() {
    static const int registered = pthread_atfork(nullptr, nullptr, &countFork);
    (void)registered;
    return g_forkGeneration.load(std::memory_order_relaxed);
}

// The easy handle of one thread, cleaned up when the thread ends; one made before a fork is
// left alone in the child (it belongs to the parent).
class ThreadHandle {
public:
    ThreadHandle() = default;
    ~ThreadHandle() {
        if (m_handle != nullptr && m_generation == forkGeneration()) {
            curl_easy_cleanup(m_handle);
        }
    }
    ThreadHandle(const ThreadHandle&) = delete;
    ThreadHandle& operator=(const ThreadHandle&) = delete;

    // The handle with every option back at its default; null when libcurl has none to give.
    CURL* fresh() {
        const unsigned generation = forkGeneration();
        if (m_handle != nullptr && m_generation == generation) {
            curl_easy_reset(m_handle);
            return m_handle;
        }
        m_handle = curl_easy_init();
        m_generation = generation;
        return m_handle;
    }

private:
    CURL* m_handle = nullptr;
    unsigned m_generation = 0;
};

// The easy handle of the calling thread, reset. A handle made afresh for each post would also
// build and tear down libcurl's internal multi handle (a socket pair and its set-up) every time;
// one per thread, reset, costs nothing of that.
CURL* threadHandle() {
    thread_local ThreadHandle handle;
    return handle.fresh();
}

class HeaderList {
public:
    HeaderList() = default;
    ~HeaderList() { curl_slist_free_all(m_list); }
    HeaderList(const HeaderList&) = delete;
    HeaderList& operator=(const HeaderList&) = delete;
    void add(const std::string& line) { m_list = curl_slist_append(m_list, line.c_str()); }
    curl_slist* get() const { return m_list; }

private:
    curl_slist* m_list = nullptr;
};

// Where the answer's body goes: the first piece reserves room for the whole body when the answer
// announced its length, so that a large body is not copied again at every piece.
struct BodySink {
    CURL* curl;
    ACE_CString& body;
};

constexpr curl_off_t kMaxReservedBody = 256 << 20;

std::size_t collectBody(char* data, std::size_t size, std::size_t count, void* target) {
    BodySink& sink = *static_cast<BodySink*>(target);
    if (sink.body.length() == 0) {
        curl_off_t announced = -1;
        curl_easy_getinfo(sink.curl, CURLINFO_CONTENT_LENGTH_DOWNLOAD_T, &announced);
        if (announced > 0 && announced <= kMaxReservedBody) {
            sink.body.fast_resize(static_cast<std::size_t>(announced));  // room, length 0
        }
    }
    sink.body.append(data, size * count);
    return size * count;
}

// "a=1; b=2": every cookie, in key order, values as they stand.
std::string cookieLine(const HttpTransport::CookieMap& cookies) {
    std::string line;
    for (const auto& cookie : cookies) {
        if (!line.empty()) {
            line += "; ";
        }
        line.append(cookie.first.c_str(), cookie.first.length());
        line += '=';
        line.append(cookie.second.c_str(), cookie.second.length());
    }
    return line;
}

// The request headers: an explicit Content-Length and none of libcurl's defaults that the
// services do not expect (no Expect: 100-continue round trip, no form content type).
void setHeaders(HeaderList& headers, std::size_t bodyLength) {
    headers.add("Content-Length: " + std::to_string(bodyLength));
    headers.add("Expect:");
    headers.add("Content-Type:");
    headers.add("Accept:");
}

void setRoute(CURL* curl, const HttpRoute& route, HeaderList& connectTo) {
    curl_easy_setopt(curl, CURLOPT_URL, route.url.c_str());
    connectTo.add("::" + route.connectHost + ":" + std::to_string(route.connectPort));
    curl_easy_setopt(curl, CURLOPT_CONNECT_TO, connectTo.get());
    if (!route.requestTarget.empty()) {
        curl_easy_setopt(curl, CURLOPT_REQUEST_TARGET, route.requestTarget.c_str());
    }
    curl_easy_setopt(curl, CURLOPT_SSL_VERIFYPEER, 1L);
    curl_easy_setopt(curl, CURLOPT_SSL_VERIFYHOST, 2L);
    if (const char* caFile = std::getenv(HttpTransport::CA_FILE_VARIABLE)) {
        curl_easy_setopt(curl, CURLOPT_CAINFO, caFile);
    }
}

// Ends an exchange in which no byte of the body went up or came down for longer than the time-out.
// A large body on a slow link keeps moving, so only a silent peer is cut. libcurl asks about once
// a second while nothing happens, so the cut comes up to a second after the time-out.
class StallWatch {
public:
    explicit StallWatch(long timeoutMs)
        : m_timeout(std::chrono::milliseconds(timeoutMs)), m_lastMove(Clock::now()) {}

    // libcurl's progress function: non-zero aborts the transfer.
    static int onProgress(void* self, curl_off_t, curl_off_t down, curl_off_t, curl_off_t up) {
        return static_cast<StallWatch*>(self)->stalled(down, up) ? 1 : 0;
    }
    // Whether the watch ended the exchange.
    bool expired() const { return m_expired; }

private:
    using Clock = std::chrono::steady_clock;

    bool stalled(curl_off_t down, curl_off_t up) {
        const Clock::time_point now = Clock::now();
        if (down != m_down || up != m_up) {
            m_down = down;
            m_up = up;
            m_lastMove = now;
        }
        m_expired = now - m_lastMove > m_timeout;
        return m_expired;
    }

    const Clock::duration m_timeout;
    Clock::time_point m_lastMove;
    curl_off_t m_down = 0;
    curl_off_t m_up = 0;
    bool m_expired = false;
};

// Every post opens its own connection and closes it after the answer (no connection is kept or
// taken up again, so a request is never sent twice), and timeoutMs is the longest silence: first
// while connecting (TLS handshake included), then between any two bytes of the exchange. A time-out
// of 0 or less waits without limit.
void setConnectionPolicy(CURL* curl, long timeoutMs, StallWatch& watch) {
    curl_easy_setopt(curl, CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(curl, CURLOPT_PROXY, "");  // never through a proxy from the environment
    curl_easy_setopt(curl, CURLOPT_PROTOCOLS_STR, "http,https");
    curl_easy_setopt(curl, CURLOPT_HTTP_VERSION, static_cast<long>(CURL_HTTP_VERSION_1_1));
    curl_easy_setopt(curl, CURLOPT_FRESH_CONNECT, 1L);
    curl_easy_setopt(curl, CURLOPT_FORBID_REUSE, 1L);
    if (timeoutMs <= 0) {
        return;
    }
    curl_easy_setopt(curl, CURLOPT_CONNECTTIMEOUT_MS, timeoutMs);
    curl_easy_setopt(curl, CURLOPT_XFERINFOFUNCTION, &StallWatch::onProgress);
    curl_easy_setopt(curl, CURLOPT_XFERINFODATA, &watch);
    curl_easy_setopt(curl, CURLOPT_NOPROGRESS, 0L);
}

HttpTransport::Outcome failure(CURL* curl, CURLcode result, const char* detail,
                               const std::string& url) {
    long requestSize = 0;
    curl_easy_getinfo(curl, CURLINFO_REQUEST_SIZE, &requestSize);
    QUORVEX_LOG(LM_DEBUG, "HttpTransport::post: %s: %s (%s)\n", url.c_str(),
                curl_easy_strerror(result), detail);
    const bool sent = requestSize > 0 && result != CURLE_SEND_ERROR;
    return sent ? HttpTransport::Outcome::NotReceived : HttpTransport::Outcome::NotSent;
}

}  // namespace

HttpTransport::Outcome HttpTransport::post(const ACE_CString& server, const ACE_CString& url,
                                           const ACE_CString& body, const CookieMap& cookies,
                                           long timeoutMs, Answer& answer) {
    initialiseCurl();
    CURL* curl = threadHandle();
    if (curl == nullptr) {
        return Outcome::NotSent;
    }
    const HttpRoute route = RouteRequest(server.c_str(), std::string(url.c_str(), url.length()));
    HeaderList connectTo;
    setRoute(curl, route, connectTo);
    StallWatch watch(timeoutMs);
    setConnectionPolicy(curl, timeoutMs, watch);

    HeaderList headers;
    setHeaders(headers, body.length());
    curl_easy_setopt(curl, CURLOPT_HTTPHEADER, headers.get());
    curl_easy_setopt(curl, CURLOPT_POST, 1L);
    curl_easy_setopt(curl, CURLOPT_POSTFIELDS, body.c_str());
    curl_easy_setopt(curl, CURLOPT_POSTFIELDSIZE_LARGE, static_cast<curl_off_t>(body.length()));
    const std::string cookieText = cookieLine(cookies);
    if (!cookieText.empty()) {
        curl_easy_setopt(curl, CURLOPT_COOKIE, cookieText.c_str());
    }

    answer.body.clear();
    BodySink sink{curl, answer.body};
    curl_easy_setopt(curl, CURLOPT_WRITEFUNCTION, &collectBody);
    curl_easy_setopt(curl, CURLOPT_WRITEDATA, &sink);
    char error[CURL_ERROR_SIZE] = "";
    curl_easy_setopt(curl, CURLOPT_ERRORBUFFER, error);

    const CURLcode result = curl_easy_perform(curl);
    if (result != CURLE_OK) {
        return failure(curl, result, watch.expired() ? "no progress within the time-out" : error,
                       route.url);
    }
    long status = 0;
    curl_easy_getinfo(curl, CURLINFO_RESPONSE_CODE, &status);
    answer.statusCode = std::to_string(status).c_str();
    return Outcome::Answered;
}

}  // namespace Configuration
