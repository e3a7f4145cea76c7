// Vesk::PointerIterator: iterates a vector of owning pointers as references to the pointees, and
// optionally only over elements whose key equals a given key (MultiElementValue::begin(key)).
#pragma once

#include <cstddef>
#include <iterator>

namespace Vesk {

template <class Base, class T>
class PointerIterator {
public:
    using iterator_category = std::forward_iterator_tag;
    using value_type = T;
    using difference_type = std::ptrdiff_t;
    using pointer = T*;
    using reference = T&;

    PointerIterator() = default;
    explicit PointerIterator(Base it) : m_it(it) {}

    reference operator*() const { return **m_it; }
    pointer operator->() const { return m_it->get(); }
    PointerIterator& operator++() {
        ++m_it;
        return *this;
    }
    PointerIterator operator++(int) {
        PointerIterator old = *this;
        ++m_it;
        return old;
    }
    bool operator==(const PointerIterator& o) const { return m_it == o.m_it; }
    bool operator!=(const PointerIterator& o) const { return m_it != o.m_it; }

private:
    Base m_it{};
};

// Skips every pointee whose key() differs from the key given at construction.
template <class Base, class T, class Key>
class KeyedIterator {
public:
    using iterator_category = std::forward_iterator_tag;
    using value_type = T;
    using difference_type = std::ptrdiff_t;
    using pointer = T*;
    using reference = T&;

    KeyedIterator() = default;
    KeyedIterator(Base it, Base end, const Key& key) : m_it(it), m_end(end), m_key(key) { skip(); }

    reference operator*() const { return **m_it; }
    pointer operator->() const { return m_it->get(); }
    KeyedIterator& operator++() {
        ++m_it;
        skip();
        return *this;
    }
    KeyedIterator operator++(int) {
        KeyedIterator old = *this;
        ++*this;
        return old;
    }
    bool operator==(const KeyedIterator& o) const { return m_it == o.m_it; }
    bool operator!=(const KeyedIterator& o) const { return m_it != o.m_it; }

private:
    void skip() {
        while (m_it != m_end && !((*m_it)->key() == m_key)) {
            ++m_it;
        }
    }
    Base m_it{};
    Base m_end{};
    Key m_key{};  // held by value: begin("Tag") with a temporary stays valid
};

}  // namespace Vesk
