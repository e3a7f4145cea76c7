// Vesk::MultiValue: an ordered list of values (of any kind, nested lists included). Owns them.
#pragma once

#include <memory>
#include <vector>

#include "Vesk/PointerIterator.h"
#include "Vesk/Value.h"

namespace Vesk {

class SingleValue;
class MultiElementValue;

class MultiValue : public Value {
public:
    using const_iterator =
        PointerIterator<std::vector<std::unique_ptr<Value>>::const_iterator, const Value>;

    MultiValue();
    MultiValue(const MultiValue& other);
    // Takes other's values (other is left empty).
    MultiValue(MultiValue&& other) noexcept;
    MultiValue& operator=(const MultiValue& other);
    ~MultiValue() override;

    // Appends an empty value of that kind and returns it for filling.
    SingleValue& addSingle();
    MultiValue& addMulti();
    MultiElementValue& addMultiElement();
    // Appends a value, taking ownership (null is refused with TrelException).
    void addValue(std::unique_ptr<Value> value);

    const_iterator begin() const { return const_iterator(m_values.begin()); }
    const_iterator end() const { return const_iterator(m_values.end()); }
    std::size_t size() const { return m_values.size(); }
    // Makes room for n values in all (a hint for readers that know the count).
    void reserve(std::size_t n) { m_values.reserve(n); }

    std::unique_ptr<Value> clone() const override;
    bool equals(const Value& other) const override;

private:
    std::vector<std::unique_ptr<Value>> m_values;
};

}  // namespace Vesk
