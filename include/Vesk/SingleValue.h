// Vesk::SingleValue: one text (an 8-bit byte string without NUL). Owned by its element. A short
// text is held inside the value itself (see ShortString).
#pragma once

#include <ace/SString.h>

#include <cstddef>

#include "Vesk/ShortString.h"
#include "Vesk/Value.h"

namespace Vesk {

class SingleValue : public Value {
public:
    SingleValue() : Value(Kind::Single) {}
    explicit SingleValue(const ACE_CString& text) : Value(Kind::Single), m_text(text) {}

    // The text.
    const ACE_CString& value() const { return m_text.str(); }
    // Replaces the text.
    void assign(const char* text) { m_text.assign(text); }
    void assign(const ACE_CString& text) { m_text.assign(text); }
    // Replaces the text by the len bytes at text.
    void assign(const char* text, std::size_t len) { m_text.assign(text, len); }

    std::unique_ptr<Value> clone() const override;
    bool equals(const Value& other) const override;

private:
    ShortString m_text;
};

}  // namespace Vesk
