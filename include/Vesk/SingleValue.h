// Vesk::SingleValue: one text (an 8-bit byte string without NUL). Owned by its element.
#pragma once

#include <ace/SString.h>

#include "Vesk/Value.h"

namespace Vesk {

class SingleValue : public Value {
public:
    SingleValue() : Value(Kind::Single) {}
    explicit SingleValue(const ACE_CString& text) : Value(Kind::Single), m_text(text) {}

    // The text.
    const ACE_CString& value() const { return m_text; }
    // Replaces the text.
    void assign(const char* text) { m_text = text; }
    void assign(const ACE_CString& text) { m_text = text; }

    std::unique_ptr<Value> clone() const override;
    bool equals(const Value& other) const override;

private:
    ACE_CString m_text;
};

}  // namespace Vesk
