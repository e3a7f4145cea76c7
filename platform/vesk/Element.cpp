#include "Vesk/Element.h"

#include <new>
#include <string>
#include <utility>

#include "NodePool.h"

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

Element::Element(const char* key, std::size_t len, int id) : m_key(key, len), m_id(id) {}

Element::Element(const Element& other)
    : m_key(other.m_key), m_id(other.m_id), m_attributes(other.m_attributes) {
    copyValue(other);
}

Element& Element::operator=(const Element& other) {
    if (this != &other) {
        Element copy(other);
        *this = std::move(copy);
    }
    return *this;
}

Element::Element(Element&& other) noexcept
    : m_key(std::move(other.m_key)), m_id(other.m_id), m_attributes(std::move(other.m_attributes)) {
    takeValue(other);
}

Element& Element::operator=(Element&& other) noexcept {
    if (this != &other) {
        // Taken out first: other may lie inside this element's value, which goes next.
        Element taken(std::move(other));
        m_key = std::move(taken.m_key);
        m_id = taken.m_id;
        m_attributes = std::move(taken.m_attributes);
        dropValue();
        takeValue(taken);
    }
    return *this;
}

Element::~Element() {
    dropValue();
}

void* Element::operator new(std::size_t size) {
    return NodePool::allocate(size);
}

void Element::operator delete(void* block, std::size_t size) noexcept {
    NodePool::deallocate(block, size);
}

void Element::dropValue() noexcept {
    if (m_value == nullptr) {
        return;
    }
    if (m_valueInline) {
        m_value->~Value();
    } else {
        delete m_value;
    }
    m_value = nullptr;
    m_valueInline = false;
}

template <class V, class... Args>
V& Element::emplaceValue(Args&&... args) {
    dropValue();
    V* value = ::new (static_cast<void*>(&m_inline)) V(std::forward<Args>(args)...);
    m_value = value;
    m_valueInline = true;
    return *value;
}

void Element::copyValue(const Element& other) {
    if (other.m_value == nullptr) {
        return;
    }
    if (!other.m_valueInline) {
        m_value = other.m_value->clone().release();
        return;
    }
    switch (other.m_value->kind()) {
        case Value::Kind::Single:
            emplaceValue<SingleValue>(static_cast<const SingleValue&>(*other.m_value));
            break;
        case Value::Kind::Multi:
            emplaceValue<MultiValue>(static_cast<const MultiValue&>(*other.m_value));
            break;
        case Value::Kind::MultiElement:
            emplaceValue<MultiElementValue>(static_cast<const MultiElementValue&>(*other.m_value));
            break;
    }
}

void Element::takeValue(Element& other) noexcept {
    if (other.m_value == nullptr) {
        return;
    }
    if (!other.m_valueInline) {
        m_value = other.m_value;
        other.m_value = nullptr;
        return;
    }
    switch (other.m_value->kind()) {
        case Value::Kind::Single:
            emplaceValue<SingleValue>(std::move(static_cast<SingleValue&>(*other.m_value)));
            break;
        case Value::Kind::Multi:
            emplaceValue<MultiValue>(std::move(static_cast<MultiValue&>(*other.m_value)));
            break;
        case Value::Kind::MultiElement:
            emplaceValue<MultiElementValue>(
                std::move(static_cast<MultiElementValue&>(*other.m_value)));
            break;
    }
    other.dropValue();
}

SingleValue& Element::addSingle() {
    return emplaceValue<SingleValue>();
}

MultiValue& Element::addMulti() {
    return emplaceValue<MultiValue>();
}

MultiElementValue& Element::addMultiElement() {
    return emplaceValue<MultiElementValue>();
}

void Element::setValue(std::unique_ptr<Value> value) {
    dropValue();
    m_value = value.release();
}

const Value& Element::value() const {
    if (m_value == nullptr) {
        throw NoValueSetEx("Vesk::Element::value: element " + quoted(key()) + " has no value");
    }
    return *m_value;
}

const SingleValue& Element::getSingle() const {
    return valueAs<const SingleValue>(key(), m_value, Value::Kind::Single, "getSingle");
}

SingleValue& Element::getSingle() {
    return valueAs<SingleValue>(key(), m_value, Value::Kind::Single, "getSingle");
}

const MultiValue& Element::getMulti() const {
    return valueAs<const MultiValue>(key(), m_value, Value::Kind::Multi, "getMulti");
}

MultiValue& Element::getMulti() {
    return valueAs<MultiValue>(key(), m_value, Value::Kind::Multi, "getMulti");
}

const MultiElementValue& Element::getMultiElement() const {
    return valueAs<const MultiElementValue>(key(), m_value, Value::Kind::MultiElement,
                                            "getMultiElement");
}

MultiElementValue& Element::getMultiElement() {
    return valueAs<MultiElementValue>(key(), m_value, Value::Kind::MultiElement, "getMultiElement");
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
