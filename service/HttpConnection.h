// HttpConnection: one client connection of the HTTP front, serving its requests one after the
// other (pipelined ones in order). Each request head must arrive whole within the request
// timeout of its first byte; path, method, declared size and service ticket are judged from the
// head alone, before a body byte is read, and a body is read only within the body limit, the
// shared body budget and a deadline that grows with its size. Quick operations run on the
// socket thread, the others on the worker pool. Owned by the asynchronous operations that hold
// it (a shared pointer); all its work runs on the one thread of its socket's context.
#pragma once

#include <boost/asio/io_context.hpp>
#include <boost/beast/core/flat_buffer.hpp>
#include <boost/beast/core/tcp_stream.hpp>
#include <boost/beast/http/empty_body.hpp>
#include <boost/beast/http/message.hpp>
#include <boost/beast/http/parser.hpp>
#include <boost/beast/http/string_body.hpp>
#include <boost/optional.hpp>
#include <memory>
#include <string>

#include "AnswerBody.h"
#include "FrontContext.h"
#include "Operations.h"

namespace ConfigurationService {

class HttpConnection : public std::enable_shared_from_this<HttpConnection> {
public:
    // A socket bound to one context (no type-erased executor on the hot path).
    using Socket = boost::asio::basic_stream_socket<boost::asio::ip::tcp,
                                                    boost::asio::io_context::executor_type>;

    // A connection over socket from peer, holding its slot. The socket's context must be run by
    // one thread only.
    HttpConnection(Socket socket, std::string peer, PeerLimiter::Slot slot, FrontContext& front);
    HttpConnection(const HttpConnection&) = delete;
    HttpConnection& operator=(const HttpConnection&) = delete;

    // Starts serving on the socket's thread.
    void start();

private:
    using Parser = boost::beast::http::request_parser<boost::beast::http::string_body>;
    using Response = boost::beast::http::response<AnswerBody>;
    using ErrorCode = boost::beast::error_code;

    void awaitRequest();
    void readHead();
    ErrorCode parseBuffered();
    void onHead(ErrorCode error);
    bool admitBody();
    void sendContinue();
    void readBody();
    void onBody(ErrorCode error);
    void runRequest();
    void answer(Reply reply);
    void refuse(int status, const std::string& message, bool close);
    void send(Reply reply, bool close);
    void onSent(ErrorCode error, bool close);
    void closeGracefully();
    void drain();
    bool refuseMalformed(ErrorCode error);

    boost::beast::basic_stream<boost::asio::ip::tcp, boost::asio::io_context::executor_type,
                               boost::beast::unlimited_rate_policy>
        m_stream;
    boost::beast::flat_buffer m_buffer;
    boost::optional<Parser> m_parser;
    boost::beast::http::response<boost::beast::http::empty_body> m_continue;
    Response m_response;
    const std::string m_peer;
    PeerLimiter::Slot m_slot;
    BodyBudget::Grant m_grant;
    FrontContext& m_front;
    const RouteHandler* m_route = nullptr;  // of the request being read
    std::size_t m_bodyLimit = 0;            // of the request being read
    unsigned m_version = 11;                // HTTP version of the request being answered
    bool m_keepAlive = true;    // whether the request being answered lets the connection live
    bool m_served = false;      // whether a request was answered on this connection
    bool m_large = false;       // whether the request or its answer was large
    std::size_t m_drained = 0;  // bytes discarded while closing
};

}  // namespace ConfigurationService
