#include "FieldCore.h"

namespace Configuration {
namespace Fields {

Lookup lookupText(const Vesk::MultiElementValue& children, const char* key,
                  const ACE_CString*& text) {
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

void writeText(Vesk::MultiElementValue& out, const char* key, const ACE_CString& text) {
    out.addElement(new Vesk::Element(keyOf(key), -1)).addSingle().assign(text);
}

void writeObject(Vesk::MultiElementValue& out, const char* key, const Vesk::Serializable& object) {
    Quorvex::auto_ptr<Vesk::Element> tree = object.writeVesk();
    tree->setKey(ACE_CString(key));
    out.addElement(tree.release());
}

}  // namespace Fields
}  // namespace Configuration
