// Vesk::Element: one node of the keyed element tree. An element has a key, an ordered list of
// attributes and at most one value (SingleValue, MultiValue or MultiElementValue), which it owns.
// Copies are deep. Plain data: not thread-safe for concurrent mutation; concurrent reads are fine.
// A value made by addSingle/addMulti/addMultiElement (or by copying) lives inside the element, a
// value given to setValue stays where it was allocated; so moving an element moves such an inner
// value (references to it do not follow), while the children of a MultiElementValue never move.
// Elements come from a pool of small blocks; new and delete may be used from any thread.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <memory>
#include <type_traits>

#include "Vesk/MultiElementValue.h"
#include "Vesk/MultiValue.h"
#include "Vesk/ShortString.h"
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
    // Same, the key being the len bytes at key.
    Element(const char* key, std::size_t len, int id);
    Element(const Element& other);
    Element& operator=(const Element& other);
    Element(Element&& other) noexcept;
    Element& operator=(Element&& other) noexcept;
    ~Element();

    // Elements come from the pool of small tree blocks; delete hands them back with their size.
    static void* operator new(std::size_t size);
    static void* operator new(std::size_t, void* where) noexcept { return where; }
    static void operator delete(void* block, std::size_t size) noexcept;

    const ACE_CString& key() const { return m_key.str(); }
    void setKey(const ACE_CString& key) { m_key.assign(key); }
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
    using InlineValue = std::aligned_union_t<0, SingleValue, MultiValue, MultiElementValue>;

    // Destroys the value, if any.
    void dropValue() noexcept;
    // Replaces the value by a V built in place from args.
    template <class V, class... Args>
    V& emplaceValue(Args&&... args);
    // Makes this element's value a copy of other's (this element has none).
    void copyValue(const Element& other);
    // Moves other's value here (this element has none; other is left with none).
    void takeValue(Element& other) noexcept;

    ShortString m_key;
    int m_id;
    bool m_valueInline = false;  // m_value points into m_inline (else it was given to setValue)
    Attributes m_attributes;
    Value* m_value = nullptr;
    InlineValue m_inline;
};

// Deep equality: key, attributes in order, and value (the id is not compared).
bool operator==(const Element& a, const Element& b);
inline bool operator!=(const Element& a, const Element& b) {
    return !(a == b);
}

}  // namespace Vesk
