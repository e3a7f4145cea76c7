#include "XmlEscape.h"

#include <array>

namespace Vesk {

namespace {

// What a byte needs: kept as it is, escaped in some modes, or refused.
enum Need : unsigned char { Plain, Always, Quote, Whitespace, Forbidden };

constexpr std::array<unsigned char, 256> makeNeeds() {
    std::array<unsigned char, 256> needs{};
    for (int c = 0; c < 0x20; ++c) {
        needs[c] = Forbidden;
    }
    needs['\t'] = Whitespace;
    needs['\n'] = Whitespace;
    needs['\r'] = Always;
    needs['&'] = Always;
    needs['<'] = Always;
    needs['>'] = Always;
    needs['"'] = Quote;
    needs['\''] = Quote;
    return needs;
}

constexpr std::array<unsigned char, 256> kNeeds = makeNeeds();

bool escapes(unsigned char need, XmlEscape::Mode mode) {
    switch (need) {
        case Always:
            return true;
        case Quote:
            return mode != XmlEscape::Mode::Text;
        case Whitespace:
            return mode == XmlEscape::Mode::AttributeValue;
        default:
            return false;
    }
}

const char* entity(char c) {
    switch (c) {
        case '&':
            return "&amp;";
        case '<':
            return "&lt;";
        case '>':
            return "&gt;";
        case '"':
            return "&quot;";
        case '\'':
            return "&apos;";
        case '\r':
            return "&#13;";
        case '\t':
            return "&#9;";
        default:
            return "&#10;";
    }
}

}  // namespace

bool XmlEscape::append(std::string& out, const char* s, std::size_t len, Mode mode) {
    const std::size_t start = out.size();
    std::size_t run = 0;  // first byte not yet appended
    for (std::size_t i = 0; i < len; ++i) {
        const unsigned char need = kNeeds[static_cast<unsigned char>(s[i])];
        if (need == Plain) {
            continue;
        }
        if (need == Forbidden) {
            out.resize(start);
            return false;
        }
        if (escapes(need, mode)) {
            out.append(s + run, i - run);
            out.append(entity(s[i]));
            run = i + 1;
        }
    }
    out.append(s + run, len - run);
    return true;
}

}  // namespace Vesk
