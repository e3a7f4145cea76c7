// One connection of the HTTP front over Boost.Beast.
#include "HttpConnection.h"

#include <boost/asio/dispatch.hpp>
#include <boost/asio/post.hpp>
#include <boost/beast/core/bind_handler.hpp>
#include <boost/beast/http/error.hpp>
#include <boost/beast/http/read.hpp>
#include <boost/beast/http/write.hpp>
#include <limits>
#include <utility>
#include <vector>

#include "Answer.h"
#include "Quorvex/Log.h"
#include "RequestRouting.h"

namespace ConfigurationService {
namespace {

namespace beast = boost::beast;
namespace http = boost::beast::http;
namespace net = boost::asio;

constexpr std::uint32_t kHeadBytes = 16 * 1024;  // request line and header fields
constexpr std::size_t kReadChunk = 4096;
constexpr std::size_t kBufferBytes = 64 * 1024;  // read buffer of one connection, at most
// Without the ticket only "GetHostName" and "GetMasterHostName" are answered: tiny bodies.
constexpr std::size_t kUnauthenticatedBodyBytes = 4096;
constexpr std::size_t kLargeBytes = 1u << 20;  // memory is given back after larger requests
constexpr std::size_t kDrainBytes = 1u << 20;  // read and dropped at most while closing
constexpr std::chrono::seconds kDrainTime{2};

const char* const kAccessDenied =
    "access denied: the request does not carry this machine's service ticket in cookie "
    "OrvelWebApplication";

// Deadline for moving bytes: the request timeout plus one second per MiB.
std::chrono::seconds timeFor(const FrontLimits& limits, std::uint64_t bytes) {
    return limits.requestTimeout + std::chrono::seconds(bytes >> 20);
}

std::vector<std::string> cookiesOf(const http::fields& head) {
    std::vector<std::string> cookies;
    const auto range = head.equal_range(http::field::cookie);
    for (auto it = range.first; it != range.second; ++it) {
        cookies.emplace_back(it->value().data(), it->value().size());
    }
    return cookies;
}

bool isHttpParseError(const beast::error_code& error) {
    return error.category() == http::make_error_code(http::error::bad_target).category() &&
           error != http::error::end_of_stream && error != http::error::partial_message;
}

bool expectsContinue(const http::fields& head) {
    return beast::iequals(head[http::field::expect], "100-continue");
}

// Runs one request; every failure becomes an answer.
Reply dispatch(const RouteHandler& dispatcher, std::string& body,
               const std::vector<std::string>& cookies, const std::string& peer) {
    try {
        return dispatcher.dispatch(body, cookies, peer);
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR, "HttpConnection: request from %s failed: %s\n", peer.c_str(),
                    e.what());
        return Reply{500, Answer::failure("", std::string("internal error: ") + e.what())};
    }
}

}  // namespace

HttpConnection::HttpConnection(Socket socket, std::string peer, PeerLimiter::Slot slot,
                               FrontContext& front)
    : m_stream(std::move(socket)),
      m_buffer(kBufferBytes),
      m_peer(std::move(peer)),
      m_slot(std::move(slot)),
      m_front(front) {}

void HttpConnection::start() {
    net::dispatch(m_stream.get_executor(),
                  beast::bind_front_handler(&HttpConnection::awaitRequest, shared_from_this()));
}

// Waits for the first byte of the next request: an idle connection lives for the keep-alive
// time (a new one for the request timeout); pipelined bytes already read go straight on.
void HttpConnection::awaitRequest() {
    m_parser.emplace();
    m_parser->header_limit(kHeadBytes);
    // The head is judged first (admitBody), then the body limited. (boost::none would refuse
    // every body in this Beast version.)
    m_parser->body_limit(std::numeric_limits<std::uint64_t>::max());
    if (m_buffer.size() > 0) {
        readHead();
        return;
    }
    m_stream.expires_after(m_served ? m_front.limits.keepAlive : m_front.limits.requestTimeout);
    m_stream.async_read_some(m_buffer.prepare(kReadChunk),
                             [self = shared_from_this()](ErrorCode error, std::size_t bytes) {
                                 if (!error) {
                                     self->m_buffer.commit(bytes);
                                     self->readHead();
                                 }
                             });
}

// The whole head must arrive within the request timeout: a trickle does not extend it. A head
// already read whole is parsed at once.
void HttpConnection::readHead() {
    m_parser->eager(false);
    ErrorCode error = parseBuffered();
    if (error != http::error::need_more) {
        onHead(error);
        return;
    }
    m_stream.expires_after(m_front.limits.requestTimeout);
    http::async_read_header(
        m_stream, m_buffer, *m_parser,
        [self = shared_from_this()](ErrorCode error, std::size_t) { self->onHead(error); });
}

// Feeds what was read to the parser: no error once it has the head (or, eager, the whole
// message), need_more when bytes are missing.
HttpConnection::ErrorCode HttpConnection::parseBuffered() {
    ErrorCode error;
    for (;;) {
        if (m_parser->is_done() || (!m_parser->eager() && m_parser->is_header_done())) {
            return ErrorCode();
        }
        if (m_buffer.size() == 0) {
            return http::error::need_more;
        }
        const std::size_t used = m_parser->put(m_buffer.data(), error);
        m_buffer.consume(used);
        if (error) {
            return error;
        }
    }
}

void HttpConnection::onHead(ErrorCode error) {
    if (error) {
        refuseMalformed(error);
        return;
    }
    if (!admitBody()) {
        return;
    }
    if (expectsContinue(m_parser->get()) && !m_parser->is_done()) {
        sendContinue();
    } else {
        readBody();
    }
}

// Judges the request from its head; answers and returns false when it is refused.
bool HttpConnection::admitBody() {
    const auto& head = m_parser->get();
    m_version = head.version();
    m_keepAlive = head.keep_alive();
    const bool bodyPending = !m_parser->is_done();
    const std::string target(head.target().data(), head.target().size());
    m_route = m_front.routes.find(RequestRouting::path(target));
    if (m_route == nullptr) {
        refuse(404, "no such service path; POST to " + m_front.routes.describe(), bodyPending);
        return false;
    }
    if (head.method() != http::verb::post) {
        refuse(405, "the configuration service answers POST only", bodyPending);
        return false;
    }
    const boost::optional<std::uint64_t> length = m_parser->content_length();
    if (length && *length > m_front.limits.maxBodyBytes) {
        refuse(413, "the request body is larger than this service accepts", bodyPending);
        return false;
    }
    const bool authenticated = m_front.tickets.accepts(cookiesOf(head));
    m_bodyLimit = authenticated ? m_front.limits.maxBodyBytes : kUnauthenticatedBodyBytes;
    if (length && *length > m_bodyLimit) {
        refuse(403, kAccessDenied, bodyPending);
        return false;
    }
    m_grant = m_front.bodies.reserve(length ? static_cast<std::size_t>(*length) : m_bodyLimit);
    if (!m_grant) {
        refuse(503, "the service is busy with other large requests; try again later", bodyPending);
        return false;
    }
    m_parser->body_limit(m_bodyLimit);
    return true;
}

void HttpConnection::sendContinue() {
    m_continue = {http::status::continue_, m_version};
    m_stream.expires_after(m_front.limits.requestTimeout);
    http::async_write(m_stream, m_continue,
                      [self = shared_from_this()](ErrorCode error, std::size_t) {
                          if (!error) {
                              self->readBody();
                          }
                      });
}

void HttpConnection::readBody() {
    m_parser->eager(true);
    ErrorCode error = parseBuffered();
    if (error != http::error::need_more) {
        onBody(error);
        return;
    }
    const auto length = m_parser->content_length();
    m_stream.expires_after(timeFor(m_front.limits, length ? *length : m_bodyLimit));
    http::async_read(
        m_stream, m_buffer, *m_parser,
        [self = shared_from_this()](ErrorCode error, std::size_t) { self->onBody(error); });
}

void HttpConnection::onBody(ErrorCode error) {
    if (error == http::error::body_limit) {
        const bool authenticated = m_bodyLimit == m_front.limits.maxBodyBytes;
        refuse(
            authenticated ? 413 : 403,
            authenticated ? "the request body is larger than this service accepts" : kAccessDenied,
            true);
        return;
    }
    if (error) {
        refuseMalformed(error);
        return;
    }
    runRequest();
}

// Runs the request: quick ones here, the others on the worker pool; the answer comes back to
// this connection's thread.
void HttpConnection::runRequest() {
    auto request = m_parser->release();
    m_parser.reset();
    std::string body = std::move(request.body());
    std::vector<std::string> cookies = cookiesOf(request);
    m_large = body.size() >= kLargeBytes;
    const RouteHandler& route = *m_route;
    if (route.isQuick(body)) {
        answer(dispatch(route, body, cookies, m_peer));
        return;
    }
    net::post(m_front.workers, [self = shared_from_this(), &route, body = std::move(body),
                                cookies = std::move(cookies)]() mutable {
        Reply reply = dispatch(route, body, cookies, self->m_peer);
        std::string().swap(body);
        net::post(self->m_stream.get_executor(),
                  [self, reply = std::move(reply)]() mutable { self->answer(std::move(reply)); });
    });
}

void HttpConnection::answer(Reply reply) {
    m_grant.release();
    m_large = m_large || reply.size() >= kLargeBytes;
    send(std::move(reply), !m_keepAlive);
}

// Answers a request refused from its head or body; close when unread bytes would follow.
void HttpConnection::refuse(int status, const std::string& message, bool close) {
    QUORVEX_LOG(LM_DEBUG, "HttpConnection: refused a request from %s: %d %s\n", m_peer.c_str(),
                status, message.c_str());
    m_grant.release();
    send(Reply{status, Answer::failure("", message)}, close || !m_keepAlive);
}

void HttpConnection::send(Reply reply, bool close) {
    const int status = reply.status;
    m_response = Response(static_cast<http::status>(status), m_version);
    m_response.set(http::field::content_type, "text/xml");
    if (status == 405) {
        m_response.set(http::field::allow, "POST");
    }
    m_response.keep_alive(!close);
    m_response.body().head = std::move(reply.body);
    m_response.body().shared = std::move(reply.shared);
    m_response.body().tail = std::move(reply.tail);
    m_response.prepare_payload();
    m_stream.expires_after(timeFor(m_front.limits, AnswerBody::size(m_response.body())));
    http::async_write(m_stream, m_response,
                      [self = shared_from_this(), close](ErrorCode error, std::size_t) {
                          self->onSent(error, close);
                      });
}

void HttpConnection::onSent(ErrorCode error, bool close) {
    m_response = Response();
    m_served = true;
    if (m_large) {
        // Large bodies leave free pages in the allocator's arenas; they go back once large
        // traffic pauses.
        m_large = false;
        m_front.trimmer.noteLarge();
    }
    if (error) {
        return;
    }
    if (close) {
        closeGracefully();
    } else {
        awaitRequest();
    }
}

// Answers a malformed head or body with 400 (431 for an oversized head) and closes; a timeout
// or a peer that went away just ends the connection. Returns whether an answer was sent.
bool HttpConnection::refuseMalformed(ErrorCode error) {
    if (error == http::error::header_limit) {
        refuse(431, "the request head is larger than this service accepts", true);
        return true;
    }
    if (isHttpParseError(error)) {
        refuse(400, "malformed HTTP request: " + error.message(), true);
        return true;
    }
    return false;
}

// Closes after the last answer. When the request was not read whole, stops sending and reads
// and drops what the peer still sends for a short while, so that the answer is not lost to a
// reset caused by unread bytes.
void HttpConnection::closeGracefully() {
    ErrorCode ignored;
    if (!m_parser && m_buffer.size() == 0) {
        m_stream.socket().shutdown(net::ip::tcp::socket::shutdown_both, ignored);
        m_stream.close();
        return;
    }
    m_stream.socket().shutdown(net::ip::tcp::socket::shutdown_send, ignored);
    m_stream.expires_after(kDrainTime);
    m_buffer.clear();
    drain();
}

void HttpConnection::drain() {
    m_stream.async_read_some(m_buffer.prepare(kReadChunk),
                             [self = shared_from_this()](ErrorCode error, std::size_t bytes) {
                                 self->m_drained += bytes;
                                 if (!error && self->m_drained < kDrainBytes) {
                                     self->drain();
                                 }
                             });
}

}  // namespace ConfigurationService
