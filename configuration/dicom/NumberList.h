// The list syntax of transfer-syntax numbers ("1,2,3", "1 2 3", "1;2;3"): decimal numbers, each
// followed by exactly one separator character, whatever it is. A stretch without digits is an
// empty token and names nothing, so "1, 2" gives 1 and 2, and "12ab3" gives 12 and 3. Only the
// ASCII digits are digits (bytes from 0x80 never are). A number accumulates in a signed 32-bit
// integer without an overflow check: longer numbers wrap around modulo 2^32, as stored documents
// have always been read. Stateless; thread-safe.
#pragma once

#include <cstddef>
#include <cstdint>

namespace Configuration {
namespace NumberList {

// Whether c is one of the ten ASCII digits.
inline bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

// Calls action(int) with each number of the text's length bytes, in order.
template <class Action>
void scan(const char* text, std::size_t length, Action&& action) {
    std::size_t position = 0;
    while (position < length) {
        std::uint32_t number = 0;  // unsigned: the wrap-around is defined
        bool digitsSeen = false;
        while (position < length && isDigit(text[position])) {
            number = number * 10u + static_cast<std::uint32_t>(text[position] - '0');
            digitsSeen = true;
            ++position;
        }
        ++position;  // the separator
        if (digitsSeen) {
            action(static_cast<std::int32_t>(number));
        }
    }
}

}  // namespace NumberList
}  // namespace Configuration
