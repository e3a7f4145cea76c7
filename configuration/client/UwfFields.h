// UwfFields: how the user-workflow records write and read their fields. A field is a child
// element whose text is the value; an empty text is left out. Reading cuts each element out of
// the record's text from its start (the service's answers are not parsed as documents); a
// missing element leaves the field as it was. Stateless helpers; thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/HttpConfigurationClient.h"
#include "Quorvex/TextConversion.h"
#include "Vesk/XmlEmitter.h"

namespace Configuration {
namespace UwfFields {

// Writes <tag>value</tag> unless value is empty.
inline void write(Vesk::XmlEmitter& xml, const char* tag, const ACE_CString& value) {
    if (!value.empty()) {
        xml.textElement(tag, value);
    }
}

// The text of element tag in text; false when it is missing.
inline bool find(const ACE_CString& text, const char* tag, ACE_CString& value) {
    ACE_CString::size_type next = 0;
    return HttpConfigurationClient::findElementText(tag, text, 0, value, next);
}

// Reads a text field as it stands.
inline void read(const ACE_CString& text, const char* tag, ACE_CString& field) {
    ACE_CString value;
    if (find(text, tag, value)) {
        field = value;
    }
}

// Reads a text field that the service sends as UTF-8 into the local code page.
inline void readUtf8(const ACE_CString& text, const char* tag, ACE_CString& field) {
    ACE_CString value;
    if (find(text, tag, value)) {
        Quorvex::ConvertUTF8StringToAnsi(value, field);
    }
}

// Reads a field through a conversion of its text.
template <class T, class Conversion>
void readAs(const ACE_CString& text, const char* tag, T& field, Conversion convert) {
    ACE_CString value;
    if (find(text, tag, value)) {
        field = convert(value);
    }
}

}  // namespace UwfFields
}  // namespace Configuration
