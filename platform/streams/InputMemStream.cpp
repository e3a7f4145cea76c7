#include "Quorvex/InputMemStream.h"

#include <algorithm>
#include <cstring>

#include "Quorvex/StreamException.h"

std::size_t InputMemStream::read(void* buf, std::size_t len) {
    const std::size_t n = std::min(len, m_len - m_pos);
    std::memcpy(buf, m_data + m_pos, n);
    m_pos += n;
    return n;
}

std::string InputMemStream::readAll(std::size_t limit) {
    const std::size_t n = m_len - m_pos;
    if (n > limit) {
        throw Quorvex::StreamException("InputMemStream: more than " + std::to_string(limit) +
                                       " bytes");
    }
    std::string out(m_data + m_pos, n);
    m_pos = m_len;
    return out;
}
