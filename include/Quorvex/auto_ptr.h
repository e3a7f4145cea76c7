// Quorvex::auto_ptr: a move-only owning pointer with a delete policy.
//
// Models the utility library's owning pointer: element trees are handed out as
// auto_ptr<Vesk::Element> (ScalarDelete) and byte buffers as
// auto_ptr<unsigned char, ArrayDelete<unsigned char>>. Exactly one auto_ptr owns a pointee;
// ownership moves with std::move or release(). Not thread-safe (a plain value).
#pragma once

#include <cstddef>
#include <utility>

namespace Quorvex {

// Deletes a single object.
template <class T>
struct ScalarDelete {
    void operator()(T* p) const { delete p; }
};

// Deletes an array made with new[].
template <class T>
struct ArrayDelete {
    void operator()(T* p) const { delete[] p; }
};

template <class T, class Policy = ScalarDelete<T>>
class auto_ptr {
public:
    // Takes ownership of p (may be null).
    explicit auto_ptr(T* p = nullptr) noexcept : m_p(p) {}
    auto_ptr(auto_ptr&& other) noexcept : m_p(other.release()) {}
    auto_ptr& operator=(auto_ptr&& other) noexcept {
        reset(other.release());
        return *this;
    }
    auto_ptr(const auto_ptr&) = delete;
    auto_ptr& operator=(const auto_ptr&) = delete;
    ~auto_ptr() { reset(); }

    // The owned pointer, ownership kept.
    T* get() const noexcept { return m_p; }
    // Gives up ownership and returns the pointer.
    T* release() noexcept { return std::exchange(m_p, nullptr); }
    // Deletes the owned object and takes p instead.
    void reset(T* p = nullptr) noexcept {
        T* old = std::exchange(m_p, p);
        if (old != nullptr) {
            Policy()(old);
        }
    }
    T& operator*() const noexcept { return *m_p; }
    T* operator->() const noexcept { return m_p; }
    T& operator[](std::size_t i) const noexcept { return m_p[i]; }
    explicit operator bool() const noexcept { return m_p != nullptr; }

private:
    T* m_p;
};

// The owning byte buffer used for stored documents and decoded Base64.
using ByteArray = auto_ptr<unsigned char, ArrayDelete<unsigned char>>;

}  // namespace Quorvex
