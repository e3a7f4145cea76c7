// Quorvex::StreamException: a stream could not be read or written (corrupt or truncated
// compressed data, a size limit passed, a write after the stream was finished).
#pragma once

#include <stdexcept>
#include <string>

namespace Quorvex {

class StreamException : public std::runtime_error {
public:
    explicit StreamException(const std::string& message) : std::runtime_error(message) {}
};

}  // namespace Quorvex
