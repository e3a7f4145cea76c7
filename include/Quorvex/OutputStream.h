// OutputStream: a sink of bytes (memory, compressed memory). Not thread-safe.
#pragma once

#include <cstddef>
#include <string>

class OutputStream {
public:
    virtual ~OutputStream() = default;
    // Appends len bytes.
    virtual void write(const void* data, std::size_t len) = 0;
    // Appends a text.
    void write(const std::string& text) { write(text.data(), text.size()); }
    // Completes what has been written (a compressing stream finishes its stream here).
    virtual void flush() {}
};
