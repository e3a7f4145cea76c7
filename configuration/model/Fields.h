// The read/write convention shared by every configuration class.
//
// A class lists its fields once, in its declared order, in a private static template
//     template <class Self, class Io> static void fields(Self& self, Io& io)
//     { io("Tag", self.m_tag); io("Value", self.m_value); ... }
// and befriends Fields::Access. Its readVesk, writeVesk and operator== are then one line each:
//     return Fields::read(*this, element, "AnonParam", Fields::FailureForm::Failed);
//     return Fields::write(*this, "AnonParam");
//     return Fields::equal(a, b);
// Reading calls every field's reader (a missing key never stops the ones after it) and returns
// true only when every key was present; it never throws: a failure is logged at LM_ERROR in the
// class's message form and the fields keep what they had. Writing builds a new tree in the same
// order; an element-tree failure becomes Vesk::Serializable::SerializableEx.
#pragma once

#include <exception>
#include <vector>

#include "FieldReaders.h"
#include "FieldWriters.h"
#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"
#include "Vesk/Serializable.h"

namespace Configuration {
namespace Fields {

// The text a read failure is logged with, after the class name.
enum class FailureForm {
    Failed,           // "::readVesk: Failed. Standard Exception: %s\n"
    PartialDefaults,  // "::readVesk: Failed - Using partial defaults. Standard Exception: %s.\n"
    PartialDefaultsNoStop,  // as PartialDefaults without the full stop
};

// Logs a caught read failure of className in the given form.
void logReadFailure(const char* className, FailureForm form, const char* what);

// Reaches a class's private field list.
struct Access {
    template <class T, class Io>
    static void visit(T& object, Io& io) {
        std::remove_const_t<T>::fields(object, io);
    }
};

// Visits fields for reading: ANDs every reader's result, without short-circuit.
class Reader {
public:
    explicit Reader(const Vesk::MultiElementValue& children) : m_children(children) {}
    template <class T>
    void operator()(const char* key, T& field) {
        m_complete = readField(m_children, key, field) && m_complete;
    }
    bool complete() const { return m_complete; }

private:
    const Vesk::MultiElementValue& m_children;
    bool m_complete = true;
};

// Visits fields for writing: appends one child per field, in order.
class Writer {
public:
    explicit Writer(Vesk::MultiElementValue& out) : m_out(out) {}
    template <class T>
    void operator()(const char* key, const T& field) {
        writeField(m_out, key, field);
    }

private:
    Vesk::MultiElementValue& m_out;
};

// Visits fields for comparison: records where each field is and how to compare it.
class Collector {
public:
    struct Ref {
        const void* field;
        bool (*equal)(const void*, const void*);
    };
    template <class T>
    void operator()(const char*, const T& field) {
        m_refs.push_back(Ref{&field, &equalAs<T>});
    }
    const std::vector<Ref>& refs() const { return m_refs; }

private:
    template <class T>
    static bool equalAs(const void* a, const void* b) {
        return *static_cast<const T*>(a) == *static_cast<const T*>(b);
    }
    std::vector<Ref> m_refs;
};

// readVesk of a class: see the file comment.
template <class T>
bool read(T& object, const Vesk::Element& element, const char* className, FailureForm form) {
    try {
        Reader reader(element.getMultiElement());
        Access::visit(object, reader);
        return reader.complete();
    } catch (const std::exception& e) {
        logReadFailure(className, form, e.what());
        return false;
    }
}

// writeVesk of a class: a new element named elementName holding one child per field.
template <class T>
Quorvex::auto_ptr<Vesk::Element> write(const T& object, const char* elementName) {
    Quorvex::auto_ptr<Vesk::Element> root(new Vesk::Element(keyOf(elementName), -1));
    try {
        Writer writer(root->addMultiElement());
        Access::visit(object, writer);
    } catch (const Vesk::TrelException&) {
        throw Vesk::Serializable::SerializableEx();
    }
    return root;
}

// operator== of a class: every field equal, in order.
template <class T>
bool equal(const T& a, const T& b) {
    Collector left;
    Collector right;
    Access::visit(a, left);
    Access::visit(b, right);
    const auto& l = left.refs();
    const auto& r = right.refs();
    for (std::size_t i = 0; i < l.size(); ++i) {
        if (!l[i].equal(l[i].field, r[i].field)) {
            return false;
        }
    }
    return l.size() == r.size();
}

}  // namespace Fields
}  // namespace Configuration
