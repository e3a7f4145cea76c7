// OutputMemStream: collects written bytes in memory. Not thread-safe.
#pragma once

#include <string>

#include "Quorvex/OutputStream.h"

class OutputMemStream : public OutputStream {
public:
    explicit OutputMemStream(std::size_t initialCapacity = 0) { m_buffer.reserve(initialCapacity); }
    using OutputStream::write;
    void write(const void* data, std::size_t len) override {
        m_buffer.append(static_cast<const char*>(data), len);
    }
    // The bytes written so far.
    const char* data() const { return m_buffer.data(); }
    std::size_t size() const { return m_buffer.size(); }
    const std::string& str() const { return m_buffer; }

private:
    std::string m_buffer;
};
