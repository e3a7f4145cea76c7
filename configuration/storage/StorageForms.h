// Field forms of the storage classes: a chain kept in the element form of ChainUtils, and the
// exact comparison of chains (ChainUtils::Link's own equality compares hosts only, which is what
// a search wants but not what a configuration's equality means).
#pragma once

#include <ace/SString.h>

#include <map>
#include <type_traits>
#include <utility>

#include "Configuration/ChainUtils.h"
#include "Configuration/RulesConfiguration.h"
#include "model/Fields.h"

namespace Configuration {
namespace StorageFields {

// Whether a and b hold links with the same definitions, types and flags, in the same order.
bool sameLinks(const ChainUtils::Chain& a, const ChainUtils::Chain& b);
// Whether a and b hold the same names with the same chains (sameLinks).
bool sameLinks(const std::map<ACE_CString, ChainUtils::Chain>& a,
               const std::map<ACE_CString, ChainUtils::Chain>& b);

template <class C>
struct ChainField : Fields::Form {
    C& chain;
    bool read(const Fields::In& in, const char* key) const {
        return ChainUtils::getChainFromVesk(Fields::keyOf(key), in.children, chain);
    }
    void write(Fields::Out& out, const char* key) const {
        ChainUtils::addChainToVesk(Fields::keyOf(key), chain, out.children);
    }
    template <class Co>
    void compare(Co&) const {}
};

// A chain under the field's key: absent reads as an empty chain and complete (see
// ChainUtils::getChainFromVesk). Left out of the field list's comparison: the class's operator==
// adds sameLinks.
template <class C>
ChainField<C> chain(C& links) {
    return ChainField<C>{{}, links};
}

template <class Table>
struct RuleItems : Fields::Form {
    Table& table;
    const char* itemKey;  // null: the rules are the field key's own repeated children

    // Every rule is added under its normalised key whatever its own read gave; the new rules
    // replace the table's in one step.
    bool read(const Fields::In& in, const char* key) const {
        const Vesk::MultiElementValue* items = &in.children;
        const char* k = key;
        std::remove_const_t<Table> fresh;
        if (itemKey != nullptr) {
            const Vesk::Element* wrapper = in.children.find(Fields::keyOf(key));
            if (wrapper == nullptr) {
                return false;
            }
            if (!wrapper->hasValue()) {
                table.replaceWith(std::move(fresh));
                return true;
            }
            items = &wrapper->getMultiElement();
            k = itemKey;
        }
        bool complete = true;
        for (const Vesk::Element& element : Fields::KeyRange{*items, Fields::keyOf(k)}) {
            typename Table::RuleType rule;
            complete = rule.readVesk(element) && complete;
            fresh.add(RulesConfiguration::normalizeKey(rule.key()), rule);
        }
        table.replaceWith(std::move(fresh));
        return complete;
    }
    void write(Fields::Out& out, const char* key) const {
        Vesk::MultiElementValue* target = &out.children;
        if (itemKey != nullptr) {
            target = &out.children.addElement(new Vesk::Element(Fields::keyOf(key), -1))
                          .addMultiElement();
        }
        const char* k = itemKey != nullptr ? itemKey : key;
        for (const auto& rule : table.rules()) {
            Fields::writeItem(*target, k, rule);
        }
    }
    template <class Co>
    void compare(Co& c) const {
        c.add(table);
    }
};

// A rule table as repeated children with the field's key (itemKey null) or as itemKey children
// of one wrapper child with the field's key (absent: missing, the table kept; no value: empty).
// Written in the order of the rules' keys.
template <class Table>
RuleItems<Table> rules(Table& table, const char* itemKey = nullptr) {
    return RuleItems<Table>{{}, table, itemKey};
}

}  // namespace StorageFields
}  // namespace Configuration
