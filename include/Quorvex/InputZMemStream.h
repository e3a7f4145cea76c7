// InputZMemStream: inflates a zlib stream (RFC 1950) held in memory that the caller keeps alive.
// Truncated or corrupt data, trailing garbage, and output beyond maxInflated bytes (a guard
// against decompression bombs) throw Quorvex::StreamException. Not thread-safe.
#pragma once

#include <cstddef>
#include <memory>

#include "Quorvex/InputStream.h"

class InputZMemStream : public InputStream {
public:
    static constexpr std::size_t kDefaultMaxInflated = 256u << 20;  // 256 MiB

    InputZMemStream(const void* data, std::size_t len,
                    std::size_t maxInflated = kDefaultMaxInflated);
    ~InputZMemStream() override;
    InputZMemStream(const InputZMemStream&) = delete;
    InputZMemStream& operator=(const InputZMemStream&) = delete;

    std::size_t read(void* buf, std::size_t len) override;
    std::string readAll(std::size_t limit) override;

private:
    struct State;
    std::unique_ptr<State> m_state;
};
