// Vesk::MultiElementValue: an ordered list of child elements, several of which may share a key.
// Owns its children. Plain data: not thread-safe for concurrent mutation.
#pragma once

#include <ace/SString.h>

#include <memory>
#include <utility>
#include <vector>

#include "Vesk/PointerIterator.h"
#include "Vesk/Value.h"

namespace Vesk {

class Element;

// Attributes of an element, in order: (name, value) pairs.
using Attributes = std::vector<std::pair<ACE_CString, ACE_CString>>;

class MultiElementValue : public Value {
    using Children = std::vector<std::unique_ptr<Element>>;

public:
    using iterator = PointerIterator<Children::const_iterator, Element>;
    using const_iterator = PointerIterator<Children::const_iterator, const Element>;
    using key_iterator = KeyedIterator<Children::const_iterator, Element, ACE_CString>;
    using const_key_iterator = KeyedIterator<Children::const_iterator, const Element, ACE_CString>;

    MultiElementValue();
    MultiElementValue(const MultiElementValue& other);
    // Takes other's children (other is left empty); references to them stay valid.
    MultiElementValue(MultiElementValue&& other) noexcept;
    MultiElementValue& operator=(const MultiElementValue& other);
    ~MultiElementValue() override;

    // The first child with that key; throws TrelException if there is none.
    const Element& getElement(const ACE_CString& key) const;
    Element& getElement(const ACE_CString& key);
    // The first child with that key, or null.
    const Element* find(const ACE_CString& key) const;
    // Whether a child with that key exists.
    bool has(const ACE_CString& key) const { return find(key) != nullptr; }

    // Appends a child, taking ownership (null is refused with TrelException).
    Element& addElement(Element* child);
    // Appends a deep copy of child.
    Element& addElement(const Element& child);
    // Appends a new child with that key and attributes and no value.
    Element& addElement(const ACE_CString& key, const Attributes& attributes, int id);

    iterator begin() { return iterator(m_children.begin()); }
    iterator end() { return iterator(m_children.end()); }
    const_iterator begin() const { return const_iterator(m_children.begin()); }
    const_iterator end() const { return const_iterator(m_children.end()); }
    // Iterate only over the children with that key.
    key_iterator begin(const ACE_CString& key) {
        return key_iterator(m_children.begin(), m_children.end(), key);
    }
    key_iterator end(const ACE_CString& key) {
        return key_iterator(m_children.end(), m_children.end(), key);
    }
    const_key_iterator begin(const ACE_CString& key) const {
        return const_key_iterator(m_children.begin(), m_children.end(), key);
    }
    const_key_iterator end(const ACE_CString& key) const {
        return const_key_iterator(m_children.end(), m_children.end(), key);
    }
    std::size_t size() const { return m_children.size(); }
    // Makes room for n children in all (a hint for readers that know the count).
    void reserve(std::size_t n) { m_children.reserve(n); }

    std::unique_ptr<Value> clone() const override;
    bool equals(const Value& other) const override;

private:
    Children m_children;
};

}  // namespace Vesk

// The inline iterators above need Element complete; this makes the header usable on its own.
#include "Vesk/Element.h"  // IWYU pragma: export
