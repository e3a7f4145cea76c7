// XmlEscape: escapes byte strings for XML 1.0 text and attribute values. Shared by XmlEmitter and
// the tree writer. Stateless and thread-safe.
#pragma once

#include <cstddef>
#include <string>

namespace Vesk {

class XmlEscape {
public:
    enum class Mode {
        Text,            // escapes & < > and CR
        TextAndQuotes,   // also " and '
        AttributeValue,  // also tab and LF, which attribute-value normalisation would turn into
                         // spaces
    };

    // Appends the len bytes of s to out, escaped for mode. Returns false and leaves out as it was
    // when s holds a byte that XML 1.0 cannot carry at all (NUL and the control characters other
    // than tab, LF and CR).
    static bool append(std::string& out, const char* s, std::size_t len, Mode mode);
};

}  // namespace Vesk
