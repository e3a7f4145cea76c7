#include "FieldReaders.h"

#include <sstream>

namespace Configuration {
namespace Fields {
namespace {

enum class Lookup { Missing, NoValue, Text };

// Finds the text of the first child with the key. A child holding another kind of value counts
// as missing, as the element library reports both with the same exception.
Lookup lookup(const Vesk::MultiElementValue& children, const char* key, const ACE_CString*& text) {
    const Vesk::Element* child = children.find(keyOf(key));
    if (child == nullptr) {
        return Lookup::Missing;
    }
    if (!child->hasValue()) {
        return Lookup::NoValue;
    }
    if (child->value().kind() != Vesk::Value::Kind::Single) {
        return Lookup::Missing;
    }
    text = &child->getSingle().value();
    return Lookup::Text;
}

// Reads the child of key into field: no child keeps the field (false); a child without a value
// resets it to its empty value; a text goes through convert(text, field).
template <class T, class Convert>
bool readText(const Vesk::MultiElementValue& children, const char* key, T& field, Convert convert) {
    const ACE_CString* text = nullptr;
    switch (lookup(children, key, text)) {
        case Lookup::Missing:
            return false;
        case Lookup::NoValue:
            field = T();
            return true;
        case Lookup::Text:
            convert(*text, field);
            return true;
    }
    return false;
}

// Extracts a number or flag with the stream's own operator (no boolalpha); a text that does not
// parse leaves the field unchanged.
template <class T>
bool readStreamed(const Vesk::MultiElementValue& children, const char* key, T& field) {
    return readText(children, key, field, [](const ACE_CString& text, T& out) {
        std::istringstream in(std::string(text.c_str(), text.length()));
        T parsed{};
        if (in >> parsed) {
            out = parsed;
        }
    });
}

// Builds a date or time from the text.
template <class T>
bool readConstructed(const Vesk::MultiElementValue& children, const char* key, T& field) {
    return readText(children, key, field, [](const ACE_CString& text, T& out) { out = T(text); });
}

}  // namespace

bool readField(const Vesk::MultiElementValue& children, const char* key, ACE_CString& field) {
    return readText(children, key, field,
                    [](const ACE_CString& text, ACE_CString& out) { out = text; });
}

bool readField(const Vesk::MultiElementValue& children, const char* key, bool& field) {
    return readStreamed(children, key, field);
}

bool readField(const Vesk::MultiElementValue& children, const char* key, int& field) {
    return readStreamed(children, key, field);
}

bool readField(const Vesk::MultiElementValue& children, const char* key, unsigned int& field) {
    return readStreamed(children, key, field);
}

bool readField(const Vesk::MultiElementValue& children, const char* key, unsigned short& field) {
    return readStreamed(children, key, field);
}

bool readField(const Vesk::MultiElementValue& children, const char* key, BDate& field) {
    return readConstructed(children, key, field);
}

bool readField(const Vesk::MultiElementValue& children, const char* key, BTime& field) {
    return readConstructed(children, key, field);
}

bool readField(const Vesk::MultiElementValue& children, const char* key,
               std::vector<ACE_CString>& field) {
    field.clear();
    const ACE_CString k = keyOf(key);
    for (auto it = children.begin(k); it != children.end(k); ++it) {
        const bool single = it->hasValue() && it->value().kind() == Vesk::Value::Kind::Single;
        field.push_back(single ? it->getSingle().value() : ACE_CString());
    }
    return true;
}

}  // namespace Fields
}  // namespace Configuration
