// Deflates into a buffer as bytes arrive, so memory holds only the compressed form. Before each
// write the buffer is made large enough for zlib's bound on what that input can become, so a
// document written in one piece is compressed into one allocation, grown once if at all; the
// buffer is not zero-filled, so pages that the compressed bytes never reach are never touched.
#include "Quorvex/OutputZMemStream.h"

#include <zlib.h>

#include <algorithm>
#include <climits>
#include <cstdlib>
#include <new>
#include <stdexcept>

#include "Quorvex/StreamException.h"

namespace {

constexpr std::size_t kMinCapacity = 64;

}  // namespace

struct OutputZMemStream::State {
    struct Free {
        void operator()(unsigned char* block) const { std::free(block); }
    };

    z_stream zs{};
    std::unique_ptr<unsigned char, Free> buffer;
    std::size_t capacity = 0;
    std::size_t used = 0;
    bool finished = false;

    // Makes the buffer hold at least size bytes (contents kept).
    void grow(std::size_t size);
    // Room for all that len more bytes of input can compress to, including the stream's end.
    void reserveFor(std::size_t len);
    // Runs deflate over [data, data + len) with the given flush mode until zlib is done with it.
    void deflateAll(const unsigned char* data, std::size_t len, int flushMode);
    // Makes room for more output and points zlib at it.
    void provideOutput();
};

void OutputZMemStream::State::grow(std::size_t size) {
    if (size <= capacity) {
        return;
    }
    void* block = std::realloc(buffer.get(), size);
    if (block == nullptr) {
        throw std::bad_alloc();
    }
    buffer.release();
    buffer.reset(static_cast<unsigned char*>(block));
    capacity = size;
}

void OutputZMemStream::State::reserveFor(std::size_t len) {
    const uLong bound =
        deflateBound(&zs, static_cast<uLong>(std::min<std::size_t>(len, ULONG_MAX)));
    if (capacity - used < bound) {
        grow(used + bound);
    }
}

void OutputZMemStream::State::provideOutput() {
    if (used == capacity) {  // the bound was passed (pending output of earlier writes)
        grow(std::max(capacity * 2, kMinCapacity));
    }
    zs.next_out = buffer.get() + used;
    zs.avail_out = static_cast<uInt>(std::min<std::size_t>(capacity - used, UINT_MAX));
}

void OutputZMemStream::State::deflateAll(const unsigned char* data, std::size_t len,
                                         int flushMode) {
    for (;;) {
        const std::size_t chunk = std::min<std::size_t>(len, UINT_MAX);
        zs.next_in = const_cast<Bytef*>(data);
        zs.avail_in = static_cast<uInt>(chunk);
        const int mode = chunk == len ? flushMode : Z_NO_FLUSH;
        int rc = Z_OK;
        do {
            provideOutput();
            const uInt before = zs.avail_out;
            rc = deflate(&zs, mode);
            used += before - zs.avail_out;
            if (rc == Z_STREAM_ERROR) {
                throw Quorvex::StreamException("OutputZMemStream: deflate failed");
            }
        } while (zs.avail_in > 0 || (mode == Z_FINISH && rc != Z_STREAM_END));
        data += chunk;
        len -= chunk;
        if (len == 0) {
            return;
        }
    }
}

OutputZMemStream::OutputZMemStream(std::size_t initialCapacity, int level) : m_state(new State) {
    if (level < Z_DEFAULT_COMPRESSION || level > Z_BEST_COMPRESSION) {
        throw std::invalid_argument("OutputZMemStream: compression level " + std::to_string(level) +
                                    " is not in -1..9");
    }
    m_state->grow(std::max(initialCapacity, kMinCapacity));
    const int rc = deflateInit(&m_state->zs, level);
    if (rc == Z_MEM_ERROR) {
        throw std::bad_alloc();
    }
    if (rc != Z_OK) {
        throw Quorvex::StreamException("OutputZMemStream: deflateInit failed");
    }
}

OutputZMemStream::~OutputZMemStream() {
    deflateEnd(&m_state->zs);
}

void OutputZMemStream::write(const void* data, std::size_t len) {
    if (m_state->finished) {
        throw Quorvex::StreamException("OutputZMemStream: write after flush");
    }
    if (len > 0) {
        m_state->reserveFor(len);
        m_state->deflateAll(static_cast<const unsigned char*>(data), len, Z_NO_FLUSH);
    }
}

void OutputZMemStream::flush() {
    if (m_state->finished) {
        return;
    }
    m_state->deflateAll(nullptr, 0, Z_FINISH);
    m_state->finished = true;
}

const unsigned char* OutputZMemStream::data() const {
    return m_state->buffer.get();
}

std::size_t OutputZMemStream::size() const {
    return m_state->used;
}
