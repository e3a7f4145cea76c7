// Room for a list read: before a list class reads its items, its vector makes room for the
// children the element holds with the item key, so that reading a long list copies no item twice.
// Never throws for an element of another kind (the read then reports that itself).
#pragma once

#include <cstddef>

#include "Vesk/Element.h"
#include "model/FieldText.h"

namespace Configuration {

template <class Vector>
void reserveForItems(const Vesk::Element& element, const char* itemKey, Vector& items) {
    if (!element.hasValue() || element.value().kind() != Vesk::Value::Kind::MultiElement) {
        return;
    }
    const Vesk::MultiElementValue& children = element.getMultiElement();
    std::size_t count = 0;
    for (auto child = children.begin(Fields::keyOf(itemKey));
         child != children.end(Fields::keyOf(itemKey)); ++child) {
        ++count;
    }
    items.reserve(items.size() + count);
}

}  // namespace Configuration

// readVesk of a list class T whose vector member holds the items of key itemKey: the convention's
// read after making room.
#define DICOM_LIST_DEFINE_READ(T, member, itemKey)                                          \
    bool T::readVesk(const Vesk::Element& element) {                                        \
        ::Configuration::reserveForItems(element, itemKey, member);                         \
        return ::Configuration::Fields::read(*this, element, #T,                            \
                                             ::Configuration::Fields::FailureForm::Failed); \
    }
