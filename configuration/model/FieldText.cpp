#include "FieldText.h"

#include <cstdio>
#include <sstream>
#include <string>

namespace Configuration {
namespace Fields {
namespace {

// Extracts with the stream's own operator (no boolalpha, leading blanks skipped, trailing text
// ignored); a text that does not parse or overflows leaves the field unchanged.
template <class T>
void streamed(const ACE_CString& text, T& field) {
    std::istringstream in(std::string(text.c_str(), text.length()));
    T parsed{};
    if (in >> parsed) {
        field = parsed;
    }
}

template <class T>
ACE_CString printed(const char* format, T value) {
    char buf[32];
    std::snprintf(buf, sizeof buf, format, value);
    return ACE_CString(buf);
}

}  // namespace

void fromText(const ACE_CString& text, ACE_CString& field) {
    field = text;
}
void fromText(const ACE_CString& text, bool& field) {
    streamed(text, field);
}
void fromText(const ACE_CString& text, int& field) {
    streamed(text, field);
}
void fromText(const ACE_CString& text, unsigned int& field) {
    streamed(text, field);
}
void fromText(const ACE_CString& text, unsigned short& field) {
    streamed(text, field);
}
void fromText(const ACE_CString& text, std::int64_t& field) {
    streamed(text, field);
}
void fromText(const ACE_CString& text, std::uint64_t& field) {
    streamed(text, field);
}
void fromText(const ACE_CString& text, BDate& field) {
    field = BDate(text);
}
void fromText(const ACE_CString& text, BTime& field) {
    field = BTime(text);
}
void fromText(const ACE_CString& text, BDateTime& field) {
    field = BDateTime(text);
}

ACE_CString toText(const ACE_CString& field) {
    return field;
}
ACE_CString toText(bool field) {
    return ACE_CString(field ? "1" : "0");
}
ACE_CString toText(int field) {
    return printed("%d", field);
}
ACE_CString toText(unsigned int field) {
    return printed("%u", field);
}
ACE_CString toText(unsigned short field) {
    return printed("%u", static_cast<unsigned int>(field));
}
ACE_CString toText(std::int64_t field) {
    return printed("%lld", static_cast<long long>(field));
}
ACE_CString toText(std::uint64_t field) {
    return printed("%llu", static_cast<unsigned long long>(field));
}
ACE_CString toText(const BDate& field) {
    return field.ToString();
}
ACE_CString toText(const BTime& field) {
    return field.ToString();
}
ACE_CString toText(const BDateTime& field) {
    return field.ToString();
}

}  // namespace Fields
}  // namespace Configuration
