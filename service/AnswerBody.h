// AnswerBody: the HTTP body of the service's answers for Boost.Beast: a text of the answer's
// own, then optionally a shared text that never changes (a document's Base64 text) and a tail,
// written as up to three buffers without joining them, so a large document goes from its one
// shared copy straight to the socket. The body owns its head and tail and shares the middle;
// the writer only reads it. Not thread-safe (one per answer being written).
#pragma once

#include <array>
#include <boost/asio/buffer.hpp>
#include <boost/beast/core/error.hpp>
#include <boost/beast/http/message.hpp>
#include <boost/optional.hpp>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace ConfigurationService {

struct AnswerBody {
    struct value_type {
        std::string head;
        std::shared_ptr<const std::string> shared;  // may be null
        std::string tail;
    };

    // The body's length (Content-Length).
    static std::uint64_t size(const value_type& body) {
        return body.head.size() + (body.shared ? body.shared->size() : 0) + body.tail.size();
    }

    class writer {
    public:
        using const_buffers_type = std::array<boost::asio::const_buffer, 3>;

        // Writes body (which outlives the writer) as it stands.
        template <bool isRequest, class Fields>
        writer(const boost::beast::http::header<isRequest, Fields>&, const value_type& body)
            : m_body(body) {}

        // Nothing to prepare.
        void init(boost::beast::error_code& error) { error = {}; }

        // All of the body at once, as the last buffers.
        boost::optional<std::pair<const_buffers_type, bool>> get(boost::beast::error_code& error) {
            error = {};
            const boost::asio::const_buffer middle =
                m_body.shared ? boost::asio::buffer(*m_body.shared) : boost::asio::const_buffer();
            return std::make_pair(const_buffers_type{boost::asio::buffer(m_body.head), middle,
                                                     boost::asio::buffer(m_body.tail)},
                                  false);
        }

    private:
        const value_type& m_body;
    };
};

}  // namespace ConfigurationService
