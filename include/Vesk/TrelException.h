// Vesk::TrelException: the element-tree library's error (missing child, wrong value kind,
// malformed or refused XML). Carries a human-readable message. Immutable; thread-safe to copy.
#pragma once

#include <stdexcept>
#include <string>

namespace Vesk {

class TrelException : public std::runtime_error {
public:
    explicit TrelException(const std::string& message) : std::runtime_error(message) {}
};

}  // namespace Vesk
