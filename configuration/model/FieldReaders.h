// Readers of one configuration field from the children of an element. Each returns true when the
// key was present: a child without a value empties the field; a text that does not parse leaves
// the field as it was; a missing key (or a child of another value kind) keeps the field and
// returns false. Lists never count as missing. The first of several same-key children wins.
#pragma once

#include <ace/SString.h>

#include <type_traits>
#include <vector>

#include "Quorvex/BDate.h"
#include "Quorvex/BTime.h"
#include "Vesk/Element.h"
#include "Vesk/Serializable.h"

namespace Configuration {
namespace Fields {

// A key as a non-owning ACE string: no allocation per look-up.
inline ACE_CString keyOf(const char* key) {
    return ACE_CString(key, nullptr, false);
}

bool readField(const Vesk::MultiElementValue& children, const char* key, ACE_CString& field);
bool readField(const Vesk::MultiElementValue& children, const char* key, bool& field);
bool readField(const Vesk::MultiElementValue& children, const char* key, int& field);
bool readField(const Vesk::MultiElementValue& children, const char* key, unsigned int& field);
bool readField(const Vesk::MultiElementValue& children, const char* key, unsigned short& field);
bool readField(const Vesk::MultiElementValue& children, const char* key, BDate& field);
bool readField(const Vesk::MultiElementValue& children, const char* key, BTime& field);
bool readField(const Vesk::MultiElementValue& children, const char* key,
               std::vector<ACE_CString>& field);

template <class T>
using IfObject = std::enable_if_t<std::is_base_of<Vesk::Serializable, T>::value, bool>;

// A nested object: a default object reads the child and replaces the field.
template <class T>
IfObject<T> readField(const Vesk::MultiElementValue& children, const char* key, T& field) {
    const Vesk::Element* child = children.find(keyOf(key));
    if (child == nullptr) {
        return false;
    }
    T fresh;
    const bool complete = fresh.readVesk(*child);
    field = fresh;
    return complete;
}

// A list of objects: one entry per child with the key, in order; true when every entry was
// complete.
template <class T>
IfObject<T> readField(const Vesk::MultiElementValue& children, const char* key,
                      std::vector<T>& field) {
    field.clear();
    bool complete = true;
    const ACE_CString k = keyOf(key);
    for (auto it = children.begin(k); it != children.end(k); ++it) {
        field.emplace_back();
        complete = field.back().readVesk(*it) && complete;
    }
    return complete;
}

}  // namespace Fields
}  // namespace Configuration
