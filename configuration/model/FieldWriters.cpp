#include "FieldWriters.h"

#include <cstdio>

#include "FieldReaders.h"

namespace Configuration {
namespace Fields {
namespace {

void writeText(Vesk::MultiElementValue& out, const char* key, const ACE_CString& text) {
    out.addElement(new Vesk::Element(keyOf(key), -1)).addSingle().assign(text);
}

// Decimal text as a standard output stream writes it (no separators).
template <class T>
void writeNumber(Vesk::MultiElementValue& out, const char* key, const char* format, T value) {
    char buf[32];
    std::snprintf(buf, sizeof buf, format, value);
    out.addElement(new Vesk::Element(keyOf(key), -1)).addSingle().assign(buf);
}

}  // namespace

void writeField(Vesk::MultiElementValue& out, const char* key, const ACE_CString& field) {
    writeText(out, key, field);
}

void writeField(Vesk::MultiElementValue& out, const char* key, bool field) {
    writeNumber(out, key, "%d", field ? 1 : 0);
}

void writeField(Vesk::MultiElementValue& out, const char* key, int field) {
    writeNumber(out, key, "%d", field);
}

void writeField(Vesk::MultiElementValue& out, const char* key, unsigned int field) {
    writeNumber(out, key, "%u", field);
}

void writeField(Vesk::MultiElementValue& out, const char* key, unsigned short field) {
    writeNumber(out, key, "%u", static_cast<unsigned int>(field));
}

void writeField(Vesk::MultiElementValue& out, const char* key, const BDate& field) {
    writeText(out, key, field.ToString());
}

void writeField(Vesk::MultiElementValue& out, const char* key, const BTime& field) {
    writeText(out, key, field.ToString());
}

void writeField(Vesk::MultiElementValue& out, const char* key,
                const std::vector<ACE_CString>& field) {
    for (const ACE_CString& entry : field) {
        writeText(out, key, entry);
    }
}

void writeObjectField(Vesk::MultiElementValue& out, const char* key,
                      const Vesk::Serializable& field) {
    Quorvex::auto_ptr<Vesk::Element> tree = field.writeVesk();
    tree->setKey(ACE_CString(key));
    out.addElement(tree.release());
}

}  // namespace Fields
}  // namespace Configuration
