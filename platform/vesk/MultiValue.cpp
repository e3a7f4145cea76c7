#include "Vesk/MultiValue.h"

#include <utility>

#include "Vesk/MultiElementValue.h"
#include "Vesk/SingleValue.h"
#include "Vesk/TrelException.h"

namespace Vesk {

MultiValue::MultiValue() : Value(Kind::Multi) {}

MultiValue::MultiValue(const MultiValue& other) : Value(other) {
    m_values.reserve(other.m_values.size());
    for (const auto& value : other.m_values) {
        m_values.push_back(value->clone());
    }
}

MultiValue::MultiValue(MultiValue&& other) noexcept
    : Value(other), m_values(std::move(other.m_values)) {}

MultiValue& MultiValue::operator=(const MultiValue& other) {
    if (this != &other) {
        MultiValue copy(other);
        m_values.swap(copy.m_values);
    }
    return *this;
}

MultiValue::~MultiValue() = default;

SingleValue& MultiValue::addSingle() {
    auto value = std::make_unique<SingleValue>();
    SingleValue& result = *value;
    m_values.push_back(std::move(value));
    return result;
}

MultiValue& MultiValue::addMulti() {
    auto value = std::make_unique<MultiValue>();
    MultiValue& result = *value;
    m_values.push_back(std::move(value));
    return result;
}

MultiElementValue& MultiValue::addMultiElement() {
    auto value = std::make_unique<MultiElementValue>();
    MultiElementValue& result = *value;
    m_values.push_back(std::move(value));
    return result;
}

void MultiValue::addValue(std::unique_ptr<Value> value) {
    if (!value) {
        throw TrelException("Vesk::MultiValue::addValue: a null value cannot be added");
    }
    m_values.push_back(std::move(value));
}

std::unique_ptr<Value> MultiValue::clone() const {
    return std::make_unique<MultiValue>(*this);
}

bool MultiValue::equals(const Value& other) const {
    if (other.kind() != Kind::Multi) {
        return false;
    }
    const auto& values = static_cast<const MultiValue&>(other).m_values;
    if (values.size() != m_values.size()) {
        return false;
    }
    for (std::size_t i = 0; i < values.size(); ++i) {
        if (!m_values[i]->equals(*values[i])) {
            return false;
        }
    }
    return true;
}

}  // namespace Vesk
