// The forms a field can take in a class's field list. Each form reads, writes and compares its
// field from the one line that names it:
//     io("Port", self.m_port);                                  // a plain field
//     io("TxDescription", Fields::optional(self.m_description)); // absent: unchanged, still
//     complete io("Enabled", Fields::optional(self.m_enabled, self.m_enabledDefault)); // absent:
//     that value io("Name", Fields::attribute(self.m_name));               // an attribute of the
//     element io("KelExportRemoteSCPs", Fields::wrapped("KelExportRemoteScp", self.m_list,
//                                               Fields::DropFailed));
//     io("PersistentTargets", Fields::pairs(self.m_targets, "Persistent", "Mirror"));
//     io("Archives", Fields::required(...));   // absent: a logged failure that ends the read
//     io("RemoteScp", Fields::basePart<RemoteSCPConfiguration>(self));  // the base's own part
// A plain field is, by its type: a scalar (string, flag, number, enumeration as its number, date,
// time, date-time) in a single-valued child; a configuration class in a nested child; a container
// of either as repeated children with the field's key (items kept when incomplete, the list
// cleared first; a list never counts as missing).
#pragma once

#include <functional>
#include <optional>

#include "FieldCore.h"

namespace Configuration {
namespace Fields {

// The base of every form; a plain field is wrapped into Plain when it is visited.
struct Form {};

// The children of one key, as a range.
struct KeyRange {
    const Vesk::MultiElementValue& children;
    ACE_CString key;
    auto begin() const { return children.begin(key); }
    auto end() const { return children.end(key); }
};

// Reads one element into an item: see readItem.
struct ElementReader {
    template <class T>
    bool operator()(const Vesk::Element& element, T& item) const {
        return readItem(element, item);
    }
};

template <class T>
bool readPlain(const In& in, const char* key, T& field) {
    if constexpr (Scalar<T>::value) {
        return readScalar(in.children, key, field);
    } else if constexpr (IsObject<T>) {
        const Vesk::Element* child = in.children.find(keyOf(key));
        if (child == nullptr) {
            return false;
        }
        T fresh;
        const bool complete = fresh.readVesk(*child);
        field = fresh;
        return complete;
    } else if constexpr (IsContainer<T>) {
        return readItems(field, KeyRange{in.children, keyOf(key)}, KeepFailed, ElementReader(),
                         NoKey());
    } else {
        static_assert(alwaysFalse<T>, "no stored form for this field type");
    }
}

template <class T>
void writePlain(Out& out, const char* key, const T& field) {
    if constexpr (IsContainer<T>) {
        forEachItem(field, [&](const auto& item) { writeItem(out.children, key, item); });
    } else {
        writeItem(out.children, key, field);
    }
}

template <class T>
struct Plain : Form {
    T& field;
    bool read(const In& in, const char* key) const { return readPlain(in, key, field); }
    void write(Out& out, const char* key) const { writePlain(out, key, field); }
    template <class C>
    void compare(C& c) const {
        c.add(field);
    }
};

// x itself when it is a form, else x as a plain field.
template <class X>
auto formOf(X& x) {
    if constexpr (std::is_base_of<Form, std::remove_cv_t<X>>::value) {
        return x;
    } else {
        return Plain<X>{{}, x};
    }
}

template <class F>
struct Optional : Form {
    F inner;
    bool* seen = nullptr;

    // Also records in flag whether the key was present (when reading: writing passes a const).
    template <class B>
    Optional noting(B& flag) const {
        Optional copy = *this;
        if constexpr (!std::is_const<B>::value) {
            copy.seen = &flag;
        }
        return copy;
    }
    bool read(const In& in, const char* key) const {
        const bool present = in.children.has(keyOf(key));
        if (seen != nullptr) {
            *seen = present;
        }
        return present ? inner.read(in, key) : true;
    }
    void write(Out& out, const char* key) const { inner.write(out, key); }
    template <class C>
    void compare(C& c) const {
        inner.compare(c);
    }
};

// Read when present; absent leaves the field (or form) as it was and does not make the read
// incomplete.
template <class X>
auto optional(X&& x) {
    return Optional<decltype(formOf(x))>{{}, formOf(x)};
}

template <class T>
struct OptionalOr : Form {
    T& field;
    std::remove_const_t<T> absent;
    bool read(const In& in, const char* key) const {
        if (!in.children.has(keyOf(key))) {
            field = absent;
            return true;
        }
        return readPlain(in, key, field);
    }
    void write(Out& out, const char* key) const { writePlain(out, key, field); }
    template <class C>
    void compare(C& c) const {
        c.add(field);
    }
};

// Read when present; absent sets the field to absentValue (taken when the line runs, so another
// field read just before may give it) and does not make the read incomplete.
template <class T, class V>
OptionalOr<T> optional(T& field, const V& absentValue) {
    return OptionalOr<T>{{}, field, absentValue};
}

template <class T>
struct Attribute : Form {
    T& field;
    bool read(const In& in, const char* key) const {
        bool found = false;
        const ACE_CString text = in.element == nullptr
                                     ? ACE_CString()
                                     : in.element->getAttributeValue(keyOf(key), found);
        if (found) {
            fromText(text, field);
        }
        return found;
    }
    void write(Out& out, const char* key) const {
        if (out.element != nullptr) {
            out.element->insertAttributes({{ACE_CString(key), toText(field)}});
        }
    }
    template <class C>
    void compare(C& c) const {
        c.add(field);
    }
};

// A scalar kept in an attribute of the element instead of a child; absent counts as missing.
template <class T>
Attribute<T> attribute(T& field) {
    return Attribute<T>{{}, field};
}

template <class C, class KeyFn>
struct Items : Form {
    C& container;
    const char* itemKey;  // null: the items are the field key's own repeated children
    unsigned policy;
    KeyFn keyFn;

    bool read(const In& in, const char* key) const {
        const auto keyOfItem = [this](const auto& item) { return std::invoke(keyFn, item); };
        if (itemKey == nullptr) {
            return readItems(container, KeyRange{in.children, keyOf(key)}, policy, ElementReader(),
                             keyOfItem);
        }
        const Vesk::Element* wrapper = in.children.find(keyOf(key));
        if (wrapper == nullptr) {
            return false;
        }
        if (!wrapper->hasValue()) {
            if ((policy & Append) == 0) {
                container.clear();
            }
            return true;
        }
        return readItems(container, KeyRange{wrapper->getMultiElement(), keyOf(itemKey)}, policy,
                         ElementReader(), keyOfItem);
    }
    void write(Out& out, const char* key) const {
        Vesk::MultiElementValue* target = &out.children;
        if (itemKey != nullptr) {
            target = &out.children.addElement(new Vesk::Element(keyOf(key), -1)).addMultiElement();
        }
        const char* k = itemKey != nullptr ? itemKey : key;
        forEachItem(container, [&](const auto& item) { writeItem(*target, k, item); });
    }
    template <class Co>
    void compare(Co& c) const {
        c.add(container);
    }
};

// Repeated children with the field's key, read by the policy; for a map, keyFn gives an item's
// key (a later item replaces an earlier one with the same key).
template <class C, class KeyFn = NoKey>
Items<C, KeyFn> items(C& container, unsigned policy, KeyFn keyFn = KeyFn()) {
    return Items<C, KeyFn>{{}, container, nullptr, policy, keyFn};
}

// Children with itemKey inside one wrapper child with the field's key. An absent wrapper counts
// as missing and keeps the container; a wrapper without a value empties it.
template <class C, class KeyFn = NoKey>
Items<C, KeyFn> wrapped(const char* itemKey, C& container, unsigned policy = KeepFailed,
                        KeyFn keyFn = KeyFn()) {
    return Items<C, KeyFn>{{}, container, itemKey, policy, keyFn};
}

// Reads and writes a record item of a list value through its field list.
struct RecordIo {
    template <class T>
    bool read(const In& in, T& item) const {
        return readRecord(in, item);
    }
    template <class T>
    void write(Out& out, const T& item) const {
        writeRecord(out, item);
    }
};

// Reads and writes a pair item of a list value as two keyed texts.
struct PairIo {
    const char* first;
    const char* second;
    template <class P>
    bool read(const In& in, P& item) const {
        const bool a = readPlain(in, first, item.first);
        const bool b = readPlain(in, second, item.second);
        return a && b;
    }
    template <class P>
    void write(Out& out, const P& item) const {
        writePlain(out, first, item.first);
        writePlain(out, second, item.second);
    }
};

template <class C, class ItemIo>
struct ListValue : Form {
    C& container;
    unsigned policy;
    ItemIo io;

    bool read(const In& in, const char* key) const {
        const Vesk::Element* child = in.children.find(keyOf(key));
        if (child == nullptr) {
            return false;
        }
        const Vesk::MultiValue empty;
        const Vesk::MultiValue& values = child->hasValue() ? child->getMulti() : empty;
        return readItems(
            container, values, policy,
            [&](const Vesk::Value& value, auto& item) { return readOne(value, item); }, NoKey());
    }
    void write(Out& out, const char* key) const {
        Vesk::MultiValue& values =
            out.children.addElement(new Vesk::Element(keyOf(key), -1)).addMulti();
        forEachItem(container, [&](const auto& item) { writeOne(values, item); });
    }
    template <class Co>
    void compare(Co& c) const {
        c.add(container);
    }

private:
    // A scalar item is a text (another kind of value reads as empty); any other item is a list of
    // keyed children (another kind of value makes the item incomplete).
    template <class T>
    bool readOne(const Vesk::Value& value, T& item) const {
        if constexpr (Scalar<T>::value) {
            if (value.kind() == Vesk::Value::Kind::Single) {
                fromText(static_cast<const Vesk::SingleValue&>(value).value(), item);
            }
            return true;
        } else {
            if (value.kind() != Vesk::Value::Kind::MultiElement) {
                return false;
            }
            return io.read(In{nullptr, static_cast<const Vesk::MultiElementValue&>(value)}, item);
        }
    }
    template <class T>
    void writeOne(Vesk::MultiValue& values, const T& item) const {
        if constexpr (Scalar<T>::value) {
            values.addSingle().assign(toText(item));
        } else {
            Out out{nullptr, values.addMultiElement()};
            io.write(out, item);
        }
    }
};

// One child holding a list value: texts for scalar items, keyed children (by the item's field
// list) for records. An absent child counts as missing; a child without a value is an empty list.
template <class C>
ListValue<C, RecordIo> listValue(C& container, unsigned policy = KeepFailed) {
    return ListValue<C, RecordIo>{{}, container, policy, RecordIo()};
}

// A list value of pairs, each item holding the keys first and second.
template <class C>
ListValue<C, PairIo> pairs(C& container, const char* first, const char* second,
                           unsigned policy = KeepFailed) {
    return ListValue<C, PairIo>{{}, container, policy, PairIo{first, second}};
}

template <class T>
struct AsSigned : Form {
    T& field;
    bool read(const In& in, const char* key) const {
        return readScalarWith(in.children, key, field, [](const ACE_CString& text, auto& out) {
            int number = static_cast<int>(out);
            fromText(text, number);
            out = static_cast<std::remove_const_t<T>>(number);
        });
    }
    void write(Out& out, const char* key) const {
        writeText(out.children, key, toText(static_cast<int>(field)));
    }
    template <class C>
    void compare(C& c) const {
        c.add(field);
    }
};

// An unsigned field stored as a signed 32-bit decimal (4294967295 is written "-1").
template <class T>
AsSigned<T> asSigned(T& field) {
    return AsSigned<T>{{}, field};
}

template <class T, class Parse, class Print>
struct Converted : Form {
    T& field;
    Parse parse;
    Print print;
    bool read(const In& in, const char* key) const {
        return readScalarWith(in.children, key, field,
                              [this](const ACE_CString& text, auto& out) { out = parse(text); });
    }
    void write(Out& out, const char* key) const { writeText(out.children, key, print(field)); }
    template <class C>
    void compare(C& c) const {
        c.add(field);
    }
};

// A field stored as a text of the class's own making: parse(text) reads it, print(field) writes
// it (for example an enumeration kept by name).
template <class T, class Parse, class Print>
Converted<T, Parse, Print> text(T& field, Parse parse, Print print) {
    return Converted<T, Parse, Print>{{}, field, parse, print};
}

template <class F>
struct Required : Form {
    F inner;
    bool read(const In& in, const char* key) const {
        in.children.getElement(keyOf(key));  // absent: the element library's TrelException
        return inner.read(in, key);
    }
    void write(Out& out, const char* key) const { inner.write(out, key); }
    template <class C>
    void compare(C& c) const {
        inner.compare(c);
    }
};

// Read like x, but an absent key is thrown, not counted: the class logs its read failure and the
// fields after it keep what they had (a child the class cannot do without).
template <class X>
auto required(X&& x) {
    return Required<decltype(formOf(x))>{{}, formOf(x)};
}

template <class B>
struct BasePart : Form {
    using Base = std::remove_const_t<B>;
    B& part;
    bool read(const In& in, const char* key) const {
        const Vesk::Element* child = in.children.find(keyOf(key));
        return child != nullptr && part.Base::readVesk(*child);
    }
    void write(Out& out, const char* key) const {
        Quorvex::auto_ptr<Vesk::Element> tree = part.Base::writeVesk();
        tree->setKey(ACE_CString(key));
        out.children.addElement(tree.release());
    }
    template <class C>
    void compare(C& c) const {
        c.add(part);
    }
};

// The part of self that its base class Base holds, read and written by Base's own readVesk and
// writeVesk (not the derived class's overrides) in a nested child.
template <class Base, class Self>
auto basePart(Self& self) {
    using B = std::conditional_t<std::is_const<Self>::value, const Base, Base>;
    return BasePart<B>{{}, static_cast<B&>(self)};
}

template <class F>
struct Uncompared : Form {
    F inner;
    bool read(const In& in, const char* key) const { return inner.read(in, key); }
    void write(Out& out, const char* key) const { inner.write(out, key); }
    template <class C>
    void compare(C&) const {}
};

// Read and written like x, but left out of equality.
template <class X>
auto uncompared(X&& x) {
    return Uncompared<decltype(formOf(x))>{{}, formOf(x)};
}

template <class T>
struct Derived : Form {
    T& field;
    bool read(const In&, const char*) const { return true; }
    void write(Out&, const char*) const {}
    template <class C>
    void compare(C& c) const {
        c.add(field);
    }
};

// Data the class derives after reading (see afterRead): compared, never read nor written. The key
// names it for readers of the field list only.
template <class T>
Derived<T> derived(T& field) {
    return Derived<T>{{}, field};
}

}  // namespace Fields
}  // namespace Configuration
