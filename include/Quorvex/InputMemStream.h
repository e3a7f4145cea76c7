// InputMemStream: reads from a byte range the caller keeps alive. Not thread-safe.
#pragma once

#include <cstddef>

#include "Quorvex/InputStream.h"

class InputMemStream : public InputStream {
public:
    InputMemStream(const void* data, std::size_t len)
        : m_data(static_cast<const char*>(data)), m_len(len) {}
    std::size_t read(void* buf, std::size_t len) override;
    std::string readAll(std::size_t limit) override;

private:
    const char* m_data;
    std::size_t m_len;
    std::size_t m_pos = 0;
};
