// Vesk::Value: the base of the three value kinds an element can hold (SingleValue, MultiValue,
// MultiElementValue). Values are owned by their element (or by the MultiValue holding them) and
// are plain data: not thread-safe for concurrent mutation. Values are allocated from the pool of
// small tree blocks (new and delete of any value kind may be used from any thread).
#pragma once

#include <cstddef>
#include <memory>

namespace Vesk {

class Value {
public:
    enum class Kind { Single, Multi, MultiElement };

    virtual ~Value() = default;
    // Which of the three kinds this is.
    Kind kind() const { return m_kind; }
    // A deep copy.
    virtual std::unique_ptr<Value> clone() const = 0;
    // Deep equality: same kind and equal contents.
    virtual bool equals(const Value& other) const = 0;

    // Values come from the pool of small tree blocks; delete hands them back with their size.
    static void* operator new(std::size_t size);
    static void* operator new(std::size_t, void* where) noexcept { return where; }
    static void operator delete(void* block, std::size_t size) noexcept;

protected:
    explicit Value(Kind kind) : m_kind(kind) {}
    Value(const Value&) = default;
    Value& operator=(const Value&) = default;

private:
    Kind m_kind;
};

}  // namespace Vesk
