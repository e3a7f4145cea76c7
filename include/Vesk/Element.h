// Vesk::Element: one node of the keyed element tree. An element has a key, an ordered list of
// attributes and at most one value (SingleValue, MultiValue or MultiElementValue), which it owns.
// Copies are deep. Plain data: not thread-safe for concurrent mutation; concurrent reads are fine.
#pragma once

#include <ace/SString.h>

#include <memory>

#include "Vesk/MultiElementValue.h"
#include "Vesk/MultiValue.h"
#include "Vesk/SingleValue.h"
#include "Vesk/TrelException.h"

namespace Vesk {

class Element {
public:
    // getSingle()/getMulti()/getMultiElement()/value() on an element that holds no value.
    class NoValueSetEx : public TrelException {
    public:
        explicit NoValueSetEx(const std::string& message) : TrelException(message) {}
    };

    // A new element with that key and no value; the integer is an id the library keeps but never
    // interprets (callers pass -1).
    explicit Element(const ACE_CString& key = ACE_CString(), int id = -1);
    Element(const Element& other);
    Element& operator=(const Element& other);
    Element(Element&& other) noexcept;
    Element& operator=(Element&& other) noexcept;
    ~Element();

    const ACE_CString& key() const { return m_key; }
    void setKey(const ACE_CString& key) { m_key = key; }
    int id() const { return m_id; }

    // Replace the value by an empty one of that kind and return it for filling.
    SingleValue& addSingle();
    MultiValue& addMulti();
    MultiElementValue& addMultiElement();
    // Replace the value (null removes it).
    void setValue(std::unique_ptr<Value> value);

    bool hasValue() const { return m_value != nullptr; }
    // The value; NoValueSetEx when there is none.
    const Value& value() const;
    // The value as that kind: NoValueSetEx when there is none, TrelException when of another kind.
    const SingleValue& getSingle() const;
    SingleValue& getSingle();
    const MultiValue& getMulti() const;
    MultiValue& getMulti();
    const MultiElementValue& getMultiElement() const;
    MultiElementValue& getMultiElement();

    // The value of the first attribute with that name; found tells whether there was one.
    ACE_CString getAttributeValue(const ACE_CString& name, bool& found) const;
    // Appends attributes, in order (duplicates are kept).
    void insertAttributes(const Attributes& attributes);
    const Attributes& attributes() const { return m_attributes; }

private:
    ACE_CString m_key;
    int m_id;
    Attributes m_attributes;
    std::unique_ptr<Value> m_value;
};

// Deep equality: key, attributes in order, and value (the id is not compared).
bool operator==(const Element& a, const Element& b);
inline bool operator!=(const Element& a, const Element& b) { return !(a == b); }

}  // namespace Vesk
