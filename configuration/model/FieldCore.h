// The pieces the field forms are built from: what a read sees and where a write goes, the friend
// that reaches a class's private field list, what kind of value a field type is, and the reading
// and writing of one stored item (a text, a nested object or a record).
#pragma once

#include <ace/SString.h>

#include <algorithm>
#include <type_traits>
#include <utility>
#include <vector>

#include "FieldText.h"
#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"
#include "Vesk/Serializable.h"

namespace Configuration {
namespace Fields {

// What a read sees: the element being read (null for an item of a list value) and its children.
struct In {
    const Vesk::Element* element;
    const Vesk::MultiElementValue& children;
};

// Where a write goes: the element being built (null for an item of a list value) and its children.
struct Out {
    Vesk::Element* element;
    Vesk::MultiElementValue& children;
};

// What a list does with an item whose read was incomplete, and whether it keeps what it held.
enum ListPolicy : unsigned {
    KeepFailed = 0,  // keep the item; the list reports false
    DropFailed = 1,  // leave the item out; the list reports false
    Append = 2,      // add to what the container holds instead of replacing it
};

// Accepts any field: lets the traits below name a field list without a real visitor.
struct NullVisitor {
    template <class X>
    void operator()(const char*, X&&) {}
};

// Reaches a class's private field list and read hook: the one friend every class names.
struct Access {
    template <class T, class Io>
    static void visit(T& object, Io& io) {
        std::remove_const_t<T>::fields(object, io);
    }

    template <class T>
    static auto hasFields(int) -> decltype(&T::template fields<T, NullVisitor>, std::true_type());
    template <class T>
    static std::false_type hasFields(long);

    // Runs the class's afterRead(), if it has one; its bool result (if any) joins the read's.
    template <class T>
    static auto afterRead(T& object, int) -> decltype(object.afterRead(), bool()) {
        if constexpr (std::is_void<decltype(object.afterRead())>::value) {
            object.afterRead();
            return true;
        } else {
            return object.afterRead();
        }
    }
    template <class T>
    static bool afterRead(T&, long) {
        return true;
    }
};

// A class with its own element: read by its readVesk, written by its writeVesk.
template <class T>
constexpr bool IsObject = std::is_base_of<Vesk::Serializable, T>::value;
// A type with a field list (a configuration class, or a record kept inside a list value).
template <class T>
constexpr bool IsRecord = decltype(Access::hasFields<T>(0))::value;

template <class T, class = void>
struct IsContainerImpl : std::false_type {};
template <class T>
struct IsContainerImpl<T, std::void_t<typename T::value_type, decltype(std::declval<T&>().begin()),
                                      decltype(std::declval<T&>().clear())>> : std::true_type {};
// A standard container (vector, set, map); ACE strings are scalars.
template <class T>
constexpr bool IsContainer = IsContainerImpl<T>::value && !Scalar<T>::value;

template <class T, class = void>
struct IsMapImpl : std::false_type {};
template <class T>
struct IsMapImpl<T, std::void_t<typename T::mapped_type>> : std::true_type {};
template <class T>
constexpr bool IsMap = IsMapImpl<T>::value;

template <class T>
constexpr bool alwaysFalse = false;

// The item type a container holds (a map holds its mapped values).
template <class C, bool = IsMap<C>>
struct ItemOf {
    using type = typename C::value_type;
};
template <class C>
struct ItemOf<C, true> {
    using type = typename C::mapped_type;
};

enum class Lookup { Missing, NoValue, Text };

// Finds the text of the first child with the key. A child holding another kind of value counts
// as missing, as the element library reports both with the same exception.
Lookup lookupText(const Vesk::MultiElementValue& children, const char* key,
                  const ACE_CString*& text);
// Appends a child key holding text.
void writeText(Vesk::MultiElementValue& out, const char* key, const ACE_CString& text);
// Appends a nested object's tree under key.
void writeObject(Vesk::MultiElementValue& out, const char* key, const Vesk::Serializable& object);

// A scalar child: no child keeps the field (false); a child without a value resets it to its
// empty value; a text goes through convert(text, field).
template <class T, class Convert>
bool readScalarWith(const Vesk::MultiElementValue& children, const char* key, T& field,
                    Convert convert) {
    const ACE_CString* text = nullptr;
    switch (lookupText(children, key, text)) {
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

template <class T>
bool readScalar(const Vesk::MultiElementValue& children, const char* key, T& field) {
    return readScalarWith(children, key, field,
                          [](const ACE_CString& text, T& out) { fromText(text, out); });
}

// Records are read and written by the visitors of Fields.h.
template <class T>
bool readRecord(const In& in, T& record);
template <class T>
void writeRecord(Out& out, const T& record);

// One item stored as an element: a nested object, a record, or a text (no value: empty).
template <class T>
bool readItem(const Vesk::Element& element, T& item) {
    if constexpr (IsObject<T>) {
        return item.readVesk(element);
    } else if constexpr (IsRecord<T>) {
        return readRecord(In{&element, element.getMultiElement()}, item);
    } else if constexpr (Scalar<T>::value) {
        const bool single =
            element.hasValue() && element.value().kind() == Vesk::Value::Kind::Single;
        if (single) {
            fromText(element.getSingle().value(), item);
        }
        return true;
    } else {
        static_assert(alwaysFalse<T>, "no stored form for this item type");
    }
}

template <class T>
void writeItem(Vesk::MultiElementValue& out, const char* key, const T& item) {
    if constexpr (IsObject<T>) {
        writeObject(out, key, item);
    } else if constexpr (IsRecord<T>) {
        Vesk::Element& element = out.addElement(new Vesk::Element(keyOf(key), -1));
        Out to{&element, element.addMultiElement()};
        writeRecord(to, item);
    } else {
        writeText(out, key, toText(item));
    }
}

template <class C, class = void>
struct HasPushBack : std::false_type {};
template <class C>
struct HasPushBack<
    C, std::void_t<decltype(std::declval<C&>().push_back(std::declval<typename C::value_type>()))>>
    : std::true_type {};

// Adds an item to a container: appended to a sequence, inserted into a set, stored under
// keyOf(item) in a map (a later item with the same key replaces the earlier one).
template <class C, class Item, class KeyFn>
void insertItem(C& container, Item&& item, const KeyFn& keyOf) {
    if constexpr (IsMap<C>) {
        auto key = keyOf(item);
        container[key] = std::forward<Item>(item);
    } else if constexpr (HasPushBack<C>::value) {
        container.push_back(std::forward<Item>(item));
    } else {
        container.insert(std::forward<Item>(item));
    }
}

// Reads items with readOne(item) into container by the policy; true when every item was complete.
template <class C, class Range, class ReadOne, class KeyFn>
bool readItems(C& container, const Range& range, unsigned policy, ReadOne readOne,
               const KeyFn& keyOf) {
    if ((policy & Append) == 0) {
        container.clear();
    }
    bool complete = true;
    for (const auto& source : range) {
        typename ItemOf<C>::type item{};
        const bool itemComplete = readOne(source, item);
        complete = itemComplete && complete;
        if (itemComplete || (policy & DropFailed) == 0) {
            insertItem(container, std::move(item), keyOf);
        }
    }
    return complete;
}

template <class T, class = void>
struct IsOrderedImpl : std::false_type {};
template <class T>
struct IsOrderedImpl<T, std::void_t<typename T::key_compare>> : std::true_type {};

// Calls fn with each item of container (a map's mapped values); a hash map's items come in the
// order of their keys, so that what is written does not depend on hashing.
template <class C, class Fn>
void forEachItem(const C& container, Fn fn) {
    if constexpr (IsMap<C> && !IsOrderedImpl<C>::value) {
        std::vector<const typename C::value_type*> entries;
        for (const auto& entry : container) {
            entries.push_back(&entry);
        }
        std::sort(entries.begin(), entries.end(),
                  [](const auto* a, const auto* b) { return a->first < b->first; });
        for (const auto* entry : entries) {
            fn(entry->second);
        }
    } else if constexpr (IsMap<C>) {
        for (const auto& entry : container) {
            fn(entry.second);
        }
    } else {
        for (const auto& item : container) {
            fn(item);
        }
    }
}

// A key function for containers that are not maps.
struct NoKey {
    template <class T>
    int operator()(const T&) const {
        return 0;
    }
};

}  // namespace Fields
}  // namespace Configuration
