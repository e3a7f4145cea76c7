#include "Vesk/Element.h"

#include <string>
#include <utility>

namespace Vesk {

namespace {

const char* kindName(Value::Kind kind) {
    switch (kind) {
        case Value::Kind::Single:
            return "a single value";
        case Value::Kind::Multi:
            return "a multi value";
        case Value::Kind::MultiElement:
            return "a multi-element value";
    }
    return "an unknown value";
}

std::string quoted(const ACE_CString& key) {
    return "'" + std::string(key.c_str(), key.length()) + "'";
}

// The value as V (of kind); NoValueSetEx or TrelException naming the caller and the key otherwise.
template <class V>
V& valueAs(const ACE_CString& key, Value* value, Value::Kind kind, const char* caller) {
    if (value == nullptr) {
        throw Element::NoValueSetEx(std::string("Vesk::Element::") + caller + ": element " +
                                    quoted(key) + " has no value");
    }
    if (value->kind() != kind) {
        throw TrelException(std::string("Vesk::Element::") + caller + ": element " + quoted(key) +
                            " holds " + kindName(value->kind()) + ", not " + kindName(kind));
    }
    return static_cast<V&>(*value);
}

}  // namespace

Element::Element(const ACE_CString& key, int id) : m_key(key), m_id(id) {}

Element::Element(const Element& other)
    : m_key(other.m_key),
      m_id(other.m_id),
      m_attributes(other.m_attributes),
      m_value(other.m_value ? other.m_value->clone() : nullptr) {}

Element& Element::operator=(const Element& other) {
    if (this != &other) {
        Element copy(other);
        *this = std::move(copy);
    }
    return *this;
}

Element::Element(Element&& other) noexcept
    : m_id(other.m_id),
      m_attributes(std::move(other.m_attributes)),
      m_value(std::move(other.m_value)) {
    m_key.swap(other.m_key);
}

Element& Element::operator=(Element&& other) noexcept {
    if (this != &other) {
        m_key.swap(other.m_key);
        other.m_key.clear();
        m_id = other.m_id;
        m_attributes = std::move(other.m_attributes);
        other.m_attributes.clear();
        m_value = std::move(other.m_value);
    }
    return *this;
}

Element::~Element() = default;

SingleValue& Element::addSingle() {
    auto value = std::make_unique<SingleValue>();
    SingleValue& result = *value;
    m_value = std::move(value);
    return result;
}

MultiValue& Element::addMulti() {
    auto value = std::make_unique<MultiValue>();
    MultiValue& result = *value;
    m_value = std::move(value);
    return result;
}

MultiElementValue& Element::addMultiElement() {
    auto value = std::make_unique<MultiElementValue>();
    MultiElementValue& result = *value;
    m_value = std::move(value);
    return result;
}

void Element::setValue(std::unique_ptr<Value> value) {
    m_value = std::move(value);
}

const Value& Element::value() const {
    if (!m_value) {
        throw NoValueSetEx("Vesk::Element::value: element " + quoted(m_key) + " has no value");
    }
    return *m_value;
}

const SingleValue& Element::getSingle() const {
    return valueAs<const SingleValue>(m_key, m_value.get(), Value::Kind::Single, "getSingle");
}

SingleValue& Element::getSingle() {
    return valueAs<SingleValue>(m_key, m_value.get(), Value::Kind::Single, "getSingle");
}

const MultiValue& Element::getMulti() const {
    return valueAs<const MultiValue>(m_key, m_value.get(), Value::Kind::Multi, "getMulti");
}

MultiValue& Element::getMulti() {
    return valueAs<MultiValue>(m_key, m_value.get(), Value::Kind::Multi, "getMulti");
}

const MultiElementValue& Element::getMultiElement() const {
    return valueAs<const MultiElementValue>(m_key, m_value.get(), Value::Kind::MultiElement,
                                            "getMultiElement");
}

MultiElementValue& Element::getMultiElement() {
    return valueAs<MultiElementValue>(m_key, m_value.get(), Value::Kind::MultiElement,
                                      "getMultiElement");
}

ACE_CString Element::getAttributeValue(const ACE_CString& name, bool& found) const {
    for (const auto& attribute : m_attributes) {
        if (attribute.first == name) {
            found = true;
            return attribute.second;
        }
    }
    found = false;
    return ACE_CString();
}

void Element::insertAttributes(const Attributes& attributes) {
    m_attributes.insert(m_attributes.end(), attributes.begin(), attributes.end());
}

bool operator==(const Element& a, const Element& b) {
    if (!(a.key() == b.key()) || a.attributes() != b.attributes() || a.hasValue() != b.hasValue()) {
        return false;
    }
    return !a.hasValue() || a.value().equals(b.value());
}

}  // namespace Vesk
