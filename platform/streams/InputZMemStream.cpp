// Inflates straight into the caller's buffer (read) or into one growing string (readAll). Every
// failure is remembered, so a stream that threw keeps throwing the same text.
#include "Quorvex/InputZMemStream.h"

#include <zlib.h>

#include <algorithm>
#include <climits>
#include <new>

#include "Quorvex/StreamException.h"

namespace {

constexpr std::size_t kMinGuess = 4096;
constexpr std::size_t kExpectedRatio = 4;

// a + b, stopping at SIZE_MAX instead of wrapping.
std::size_t saturatingAdd(std::size_t a, std::size_t b) {
    return a > SIZE_MAX - b ? SIZE_MAX : a + b;
}

}  // namespace

struct InputZMemStream::State {
    z_stream zs{};
    const unsigned char* next = nullptr;  // input not yet handed to zlib
    std::size_t left = 0;
    std::size_t maxInflated = 0;
    std::size_t produced = 0;
    bool ended = false;
    std::string error;  // set once the stream has failed

    // Inflates up to len bytes into out; returns how many, fewer only at the end of the stream.
    std::size_t inflateInto(unsigned char* out, std::size_t len);
    // Throws the failure, remembering it for later calls.
    [[noreturn]] void fail(const std::string& what);
    void feedInput();
    void checkEnd();
};

void InputZMemStream::State::fail(const std::string& what) {
    error = "InputZMemStream: " + what;
    throw Quorvex::StreamException(error);
}

void InputZMemStream::State::feedInput() {
    if (zs.avail_in == 0 && left > 0) {
        const std::size_t chunk = std::min<std::size_t>(left, UINT_MAX);
        zs.next_in = const_cast<Bytef*>(next);
        zs.avail_in = static_cast<uInt>(chunk);
        next += chunk;
        left -= chunk;
    }
}

void InputZMemStream::State::checkEnd() {
    ended = true;
    const std::size_t trailing = zs.avail_in + left;
    if (trailing > 0) {
        fail(std::to_string(trailing) + " trailing bytes after the end of the zlib stream");
    }
}

std::size_t InputZMemStream::State::inflateInto(unsigned char* out, std::size_t len) {
    if (!error.empty()) {
        throw Quorvex::StreamException(error);
    }
    // One byte beyond the limit is allowed in so that passing the limit is noticed.
    len = std::min(len, saturatingAdd(maxInflated - produced, 1));
    std::size_t done = 0;
    while (done < len && !ended) {
        feedInput();
        zs.next_out = out + done;
        zs.avail_out = static_cast<uInt>(std::min<std::size_t>(len - done, UINT_MAX));
        const uInt before = zs.avail_out;
        const int rc = inflate(&zs, Z_NO_FLUSH);
        done += before - zs.avail_out;
        produced += before - zs.avail_out;
        if (rc == Z_STREAM_END) {
            checkEnd();
        } else if (rc == Z_MEM_ERROR) {
            throw std::bad_alloc();
        } else if (rc == Z_NEED_DICT || rc == Z_DATA_ERROR || rc == Z_STREAM_ERROR) {
            fail(std::string("corrupt zlib data (") + (zs.msg ? zs.msg : "preset dictionary") +
                 ")");
        } else if (zs.avail_out > 0 && zs.avail_in == 0 && left == 0) {
            fail("truncated zlib data");
        }
    }
    if (produced > maxInflated) {
        fail("inflated data exceeds the limit of " + std::to_string(maxInflated) + " bytes");
    }
    return done;
}

InputZMemStream::InputZMemStream(const void* data, std::size_t len, std::size_t maxInflated)
    : m_state(new State) {
    m_state->next = static_cast<const unsigned char*>(data);
    m_state->left = len;
    m_state->maxInflated = maxInflated;
    const int rc = inflateInit(&m_state->zs);
    if (rc == Z_MEM_ERROR) {
        throw std::bad_alloc();
    }
    if (rc != Z_OK) {
        throw Quorvex::StreamException("InputZMemStream: inflateInit failed");
    }
}

InputZMemStream::~InputZMemStream() {
    inflateEnd(&m_state->zs);
}

std::size_t InputZMemStream::read(void* buf, std::size_t len) {
    return m_state->inflateInto(static_cast<unsigned char*>(buf), len);
}

std::string InputZMemStream::readAll(std::size_t limit) {
    // Room for limit + 1 bytes at most: the extra byte shows that the limit was passed.
    const std::size_t cap = saturatingAdd(limit, 1);
    const std::size_t guess = saturatingAdd(
        m_state->left > SIZE_MAX / kExpectedRatio ? SIZE_MAX : m_state->left * kExpectedRatio,
        kMinGuess);
    std::string out(std::min(guess, cap), '\0');
    std::size_t used = 0;
    for (;;) {
        used +=
            m_state->inflateInto(reinterpret_cast<unsigned char*>(&out[used]), out.size() - used);
        if (used > limit) {
            m_state->fail("more than " + std::to_string(limit) + " bytes");
        }
        if (m_state->ended) {
            out.resize(used);
            return out;
        }
        out.resize(std::min(saturatingAdd(out.size(), out.size()), cap));
    }
}
