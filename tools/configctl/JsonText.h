// JsonText: configctl's --output json. jsonString quotes one string; JsonWriter writes one JSON
// value to a stream as it is built, with the commas between members, on one line followed by a
// line break. Names arrive in the 8-bit code page (Latin-1); the output is plain ASCII, every
// other character written as \uXXXX. jsonString is stateless and thread-safe; a JsonWriter
// belongs to one thread and writes to a stream it does not own.
#pragma once

#include <ace/SString.h>

#include <ostream>
#include <string>
#include <type_traits>
#include <vector>

namespace Configctl {

// text as a quoted JSON string, its bytes taken as Latin-1 characters.
std::string jsonString(const std::string& text);

class JsonWriter {
public:
    // Writes to out, which must outlive the writer.
    explicit JsonWriter(std::ostream& out) : m_out(out) {}

    // Opens an object, as the whole value, an array element or after key().
    JsonWriter& beginObject();
    // Closes the innermost object; after the outermost value, ends the line.
    JsonWriter& endObject();
    // Opens an array.
    JsonWriter& beginArray();
    // Closes the innermost array; after the outermost value, ends the line.
    JsonWriter& endArray();
    // The name of the next member of the open object.
    JsonWriter& key(const char* name);
    // A string value.
    JsonWriter& value(const std::string& text);
    // A string value.
    JsonWriter& value(const char* text) { return value(std::string(text)); }
    // A string value; its bytes as stored, embedded NULs included.
    JsonWriter& value(const ACE_CString& text) {
        return value(std::string(text.c_str(), text.length()));
    }
    // true or false.
    JsonWriter& value(bool flag);
    // A whole number.
    template <class Number, class = std::enable_if_t<std::is_integral<Number>::value &&
                                                     !std::is_same<Number, bool>::value>>
    JsonWriter& value(Number number) {
        return raw(std::to_string(number));
    }
    // null.
    JsonWriter& null() { return raw("null"); }
    // The string text, or null when it is empty.
    JsonWriter& optional(const std::string& text) { return text.empty() ? null() : value(text); }
    // A member of the open object: key(name), then value.
    template <class Value>
    JsonWriter& field(const char* name, const Value& v) {
        key(name);
        return value(v);
    }

private:
    JsonWriter& raw(const std::string& token);
    void separate();
    JsonWriter& open(char bracket);
    JsonWriter& close(char bracket);

    std::ostream& m_out;
    std::vector<bool> m_empty;  // per open object or array: nothing written in it yet
    bool m_afterKey = false;
};

}  // namespace Configctl
