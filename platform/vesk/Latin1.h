// Latin1: turns the UTF-8 strings that pugixml hands out back into the 8-bit ISO-8859-1 byte
// strings of the element tree. Stateless and thread-safe.
#pragma once

#include <string>
#include <string_view>

namespace Vesk {

class Latin1 {
public:
    // A non-owning view of the NUL-terminated UTF-8 string utf8 as ISO-8859-1 bytes: it points
    // into utf8 itself when that is plain ASCII (the common case, no copy), else into scratch.
    // Valid while both live and scratch is not reused. TrelException for broken UTF-8 or a
    // character above U+00FF.
    static std::string_view view(const char* utf8, std::string& scratch);
};

}  // namespace Vesk
