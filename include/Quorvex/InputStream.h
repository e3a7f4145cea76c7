// InputStream: a source of bytes (memory, compressed memory). Not thread-safe.
#pragma once

#include <cstddef>
#include <string>

class InputStream {
public:
    virtual ~InputStream() = default;
    // Reads up to len bytes into buf; returns how many, 0 at the end. Corrupt input throws
    // Quorvex::StreamException.
    virtual std::size_t read(void* buf, std::size_t len) = 0;
    // Reads everything that is left. More than limit bytes throws Quorvex::StreamException.
    virtual std::string readAll(std::size_t limit);
};
