// Vesk::Value: the base of the three value kinds an element can hold (SingleValue, MultiValue,
// MultiElementValue). Values are owned by their element (or by the MultiValue holding them) and
// are plain data: not thread-safe for concurrent mutation.
#pragma once

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

protected:
    explicit Value(Kind kind) : m_kind(kind) {}
    Value(const Value&) = default;
    Value& operator=(const Value&) = default;

private:
    Kind m_kind;
};

}  // namespace Vesk
