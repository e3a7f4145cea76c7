// The read/write convention shared by every configuration class.
//
// A class lists its fields once, in its declared (written) order, in the private static template
// that CONFIGURATION_CLASS declares:
//     template <class Self, class Io> void AnonParam::fields(Self& self, Io& io)
//     { io("Tag", self.m_tag); io("Value", self.m_value); ... }
// and its .cpp says CONFIGURATION_DEFINE(AnonParam, "AnonParam", Fields::FailureForm::Failed)
// (ClassDefinition.h). Each line of the field list is read, written and compared from the same
// place; the forms a line can take are in FieldForms.h.
//
// Reading calls every field's reader (a missing key never stops the ones after it), then the
// class's afterRead() hook if it has one, and returns true only when every key was present; it
// never throws: a failure is logged at LM_ERROR in the class's message form and the fields keep
// what they had. Writing builds a new tree in the same order; an element-tree failure becomes
// Vesk::Serializable::SerializableEx.
#pragma once

#include <exception>
#include <vector>

#include "FieldForms.h"

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

// What writeVesk of a read-only class throws: a std::exception with a fixed text.
class WriteRefused : public std::exception {
public:
    explicit WriteRefused(const char* text) : m_text(text) {}
    const char* what() const noexcept override { return m_text; }

private:
    const char* m_text;
};

// Visits fields for reading: ANDs every reader's result, without short-circuit.
class Reader {
public:
    explicit Reader(const In& in) : m_in(in) {}
    template <class X>
    void operator()(const char* key, X&& x) {
        m_complete = formOf(x).read(m_in, key) && m_complete;
    }
    bool complete() const { return m_complete; }

private:
    In m_in;
    bool m_complete = true;
};

// Visits fields for writing: appends one child (or attribute) per field, in order.
class Writer {
public:
    explicit Writer(Out& out) : m_out(out) {}
    template <class X>
    void operator()(const char* key, const X& x) {
        formOf(x).write(m_out, key);
    }

private:
    Out& m_out;
};

// Visits fields for comparison: records where each compared value is and how to compare it.
class Collector {
public:
    struct Ref {
        const void* field;
        bool (*equal)(const void*, const void*);
    };
    template <class X>
    void operator()(const char*, const X& x) {
        formOf(x).compare(*this);
    }
    template <class T>
    void add(const T& field) {
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

template <class T>
bool readRecord(const In& in, T& record) {
    Reader reader(in);
    Access::visit(record, reader);
    const bool hooked = Access::afterRead(record, 0);
    return hooked && reader.complete();
}

template <class T>
void writeRecord(Out& out, const T& record) {
    Writer writer(out);
    Access::visit(record, writer);
}

// readVesk of a class: see the file comment.
template <class T>
bool read(T& object, const Vesk::Element& element, const char* className, FailureForm form) {
    try {
        return readRecord(In{&element, element.getMultiElement()}, object);
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
        Out out{root.get(), root->addMultiElement()};
        writeRecord(out, object);
    } catch (const Vesk::TrelException&) {
        throw Vesk::Serializable::SerializableEx();
    }
    return root;
}

// operator== of a class: every compared field equal, in order.
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
