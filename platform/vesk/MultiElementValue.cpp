#include "Vesk/MultiElementValue.h"

#include <string>
#include <utility>

#include "Vesk/Element.h"
#include "Vesk/TrelException.h"

namespace Vesk {

MultiElementValue::MultiElementValue() : Value(Kind::MultiElement) {}

MultiElementValue::MultiElementValue(const MultiElementValue& other) : Value(other) {
    m_children.reserve(other.m_children.size());
    for (const auto& child : other.m_children) {
        m_children.push_back(std::make_unique<Element>(*child));
    }
}

MultiElementValue::MultiElementValue(MultiElementValue&& other) noexcept
    : Value(other), m_children(std::move(other.m_children)) {}

MultiElementValue& MultiElementValue::operator=(const MultiElementValue& other) {
    if (this != &other) {
        MultiElementValue copy(other);
        m_children.swap(copy.m_children);
    }
    return *this;
}

MultiElementValue::~MultiElementValue() = default;

const Element* MultiElementValue::find(const ACE_CString& key) const {
    for (const auto& child : m_children) {
        if (child->key() == key) {
            return child.get();
        }
    }
    return nullptr;
}

const Element& MultiElementValue::getElement(const ACE_CString& key) const {
    const Element* child = find(key);
    if (child == nullptr) {
        throw TrelException("Vesk::MultiElementValue::getElement: no child with key '" +
                            std::string(key.c_str(), key.length()) + "'");
    }
    return *child;
}

Element& MultiElementValue::getElement(const ACE_CString& key) {
    return const_cast<Element&>(static_cast<const MultiElementValue&>(*this).getElement(key));
}

Element& MultiElementValue::addElement(Element* child) {
    if (child == nullptr) {
        throw TrelException("Vesk::MultiElementValue::addElement: a null child cannot be added");
    }
    std::unique_ptr<Element> owned(child);
    m_children.push_back(std::move(owned));
    return *child;
}

Element& MultiElementValue::addElement(const Element& child) {
    return addElement(new Element(child));
}

Element& MultiElementValue::addElement(const ACE_CString& key, const Attributes& attributes,
                                       int id) {
    auto child = std::make_unique<Element>(key, id);
    child->insertAttributes(attributes);
    return addElement(child.release());
}

std::unique_ptr<Value> MultiElementValue::clone() const {
    return std::make_unique<MultiElementValue>(*this);
}

bool MultiElementValue::equals(const Value& other) const {
    if (other.kind() != Kind::MultiElement) {
        return false;
    }
    const auto& children = static_cast<const MultiElementValue&>(other).m_children;
    if (children.size() != m_children.size()) {
        return false;
    }
    for (std::size_t i = 0; i < children.size(); ++i) {
        if (*m_children[i] != *children[i]) {
            return false;
        }
    }
    return true;
}

}  // namespace Vesk
