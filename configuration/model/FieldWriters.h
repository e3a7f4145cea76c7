// Writers of one configuration field as child elements: every value is a SingleValue holding the
// text that the matching reader accepts (flags "1"/"0", decimal numbers, BDate/BTime text forms).
// Nested objects are their own writeVesk tree under the field's key; lists are one child per entry.
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

void writeField(Vesk::MultiElementValue& out, const char* key, const ACE_CString& field);
void writeField(Vesk::MultiElementValue& out, const char* key, bool field);
void writeField(Vesk::MultiElementValue& out, const char* key, int field);
void writeField(Vesk::MultiElementValue& out, const char* key, unsigned int field);
void writeField(Vesk::MultiElementValue& out, const char* key, unsigned short field);
void writeField(Vesk::MultiElementValue& out, const char* key, const BDate& field);
void writeField(Vesk::MultiElementValue& out, const char* key, const BTime& field);
void writeField(Vesk::MultiElementValue& out, const char* key,
                const std::vector<ACE_CString>& field);
// Appends a nested object's tree under key.
void writeObjectField(Vesk::MultiElementValue& out, const char* key,
                      const Vesk::Serializable& field);

template <class T>
std::enable_if_t<std::is_base_of<Vesk::Serializable, T>::value> writeField(
    Vesk::MultiElementValue& out, const char* key, const T& field) {
    writeObjectField(out, key, field);
}

template <class T>
std::enable_if_t<std::is_base_of<Vesk::Serializable, T>::value> writeField(
    Vesk::MultiElementValue& out, const char* key, const std::vector<T>& field) {
    for (const T& entry : field) {
        writeObjectField(out, key, entry);
    }
}

}  // namespace Fields
}  // namespace Configuration
