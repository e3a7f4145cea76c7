// How one scalar field is spelled as text: fromText converts a stored text into the field (a text
// that does not parse leaves the field as it was), toText gives the text that fromText accepts
// back (flags "1"/"0", decimal numbers, the BDate/BTime/BDateTime text forms). Enumerations are
// stored as their number. Scalar<T> tells which types have a text form.
#pragma once

#include <ace/SString.h>

#include <cstdint>
#include <type_traits>

#include "Quorvex/BDate.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/BTime.h"

namespace Configuration {
namespace Fields {

// A key as a non-owning ACE string: no allocation per look-up.
inline ACE_CString keyOf(const char* key) {
    return ACE_CString(key, nullptr, false);
}

void fromText(const ACE_CString& text, ACE_CString& field);
void fromText(const ACE_CString& text, bool& field);
void fromText(const ACE_CString& text, int& field);
void fromText(const ACE_CString& text, unsigned int& field);
void fromText(const ACE_CString& text, unsigned short& field);
void fromText(const ACE_CString& text, std::int64_t& field);
void fromText(const ACE_CString& text, std::uint64_t& field);
void fromText(const ACE_CString& text, BDate& field);
void fromText(const ACE_CString& text, BTime& field);
void fromText(const ACE_CString& text, BDateTime& field);

ACE_CString toText(const ACE_CString& field);
ACE_CString toText(bool field);
ACE_CString toText(int field);
ACE_CString toText(unsigned int field);
ACE_CString toText(unsigned short field);
ACE_CString toText(std::int64_t field);
ACE_CString toText(std::uint64_t field);
ACE_CString toText(const BDate& field);
ACE_CString toText(const BTime& field);
ACE_CString toText(const BDateTime& field);

// Enumerations: their number, read as a signed 32-bit decimal.
template <class E, std::enable_if_t<std::is_enum<E>::value, int> = 0>
void fromText(const ACE_CString& text, E& field) {
    int number = static_cast<int>(field);
    fromText(text, number);
    field = static_cast<E>(number);
}
template <class E, std::enable_if_t<std::is_enum<E>::value, int> = 0>
ACE_CString toText(E field) {
    return toText(static_cast<int>(field));
}

// Whether T is stored as one text (has fromText/toText).
template <class T, class = void>
struct Scalar : std::false_type {};
template <class T>
struct Scalar<
    T, std::void_t<decltype(fromText(std::declval<const ACE_CString&>(), std::declval<T&>()))>>
    : std::true_type {};

}  // namespace Fields
}  // namespace Configuration
