// OutputZMemStream: compresses what is written into memory as one zlib stream (RFC 1950), so any
// zlib tool can inflate the result. flush() finishes the stream; data()/size() are the compressed
// bytes, complete only after flush(). Writing after flush() throws Quorvex::StreamException.
// Not thread-safe.
#pragma once

#include <memory>
#include <string>

#include "Quorvex/OutputStream.h"

class OutputZMemStream : public OutputStream {
public:
    // initialCapacity: bytes reserved for the compressed output; level: zlib level 0-9.
    explicit OutputZMemStream(std::size_t initialCapacity = 5120, int level = 9);
    ~OutputZMemStream() override;
    OutputZMemStream(const OutputZMemStream&) = delete;
    OutputZMemStream& operator=(const OutputZMemStream&) = delete;

    using OutputStream::write;
    void write(const void* data, std::size_t len) override;
    void flush() override;

    const unsigned char* data() const;
    std::size_t size() const;

private:
    struct State;
    std::unique_ptr<State> m_state;
};
