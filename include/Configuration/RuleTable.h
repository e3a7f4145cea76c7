// Configuration::RuleTable<Rule>: a table of routing rules by their normalised key (the
// upper-cased AE title; callers normalise), kept in a hash map opened with 1024 buckets and
// guarded by a readers-writer mutex: look-ups share it, changes take it alone, so a table may be
// consulted from several threads while another changes or replaces it. Two rules with the same
// key: the first one added stays, the second is refused. Copies and assignment copy the rules
// (under the source's read lock); the mutex is never copied.
#pragma once

#include <ace/Guard_T.h>
#include <ace/RW_Thread_Mutex.h>
#include <ace/SString.h>

#include <algorithm>
#include <memory>
#include <unordered_map>
#include <utility>
#include <vector>

#include "Configuration/StringHash.h"

namespace Configuration {

template <class Rule>
class RuleTable {
public:
    using RuleType = Rule;
    using Map = std::unordered_map<ACE_CString, Rule, StringHash>;
    static constexpr std::size_t kBuckets = 1024;

    RuleTable() : m_rules(kBuckets) {}
    RuleTable(const RuleTable& other) : m_rules(other.snapshot()) {}
    RuleTable& operator=(const RuleTable& other) {
        if (this != &other) {
            Map copy = other.snapshot();
            ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
            m_rules.swap(copy);
        }
        return *this;
    }

    // Stores a copy of rule under key; false when the key is taken.
    bool add(const ACE_CString& key, const Rule& rule) {
        ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        return m_rules.emplace(key, rule).second;
    }
    // Removes the rule under key; false when there is none.
    bool remove(const ACE_CString& key) {
        ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        return m_rules.erase(key) == 1;
    }
    // A new copy of the rule under key, or an empty pointer.
    std::unique_ptr<Rule> find(const ACE_CString& key) const {
        ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        const auto it = m_rules.find(key);
        return it == m_rules.end() ? std::unique_ptr<Rule>() : std::make_unique<Rule>(it->second);
    }
    // Whether the table holds no rule.
    bool empty() const {
        ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        return m_rules.empty();
    }
    // How many rules the table holds.
    std::size_t size() const {
        ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        return m_rules.size();
    }
    // Every rule, in the order of their keys.
    std::vector<Rule> rules() const {
        const Map copy = snapshot();
        std::vector<const typename Map::value_type*> entries;
        for (const auto& entry : copy) {
            entries.push_back(&entry);
        }
        std::sort(entries.begin(), entries.end(),
                  [](const auto* a, const auto* b) { return a->first < b->first; });
        std::vector<Rule> result;
        for (const auto* entry : entries) {
            result.push_back(entry->second);
        }
        return result;
    }
    // Replaces the rules by those of fresh, a table no other thread sees, in one step: readers
    // see the old rules or the new ones.
    void replaceWith(RuleTable&& fresh) {
        ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        m_rules.swap(fresh.m_rules);
    }

    // Equal when both hold equal rules under the same keys.
    friend bool operator==(const RuleTable& a, const RuleTable& b) {
        if (&a == &b) {
            return true;
        }
        const Map other = b.snapshot();
        ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(a.m_lock);
        return a.m_rules == other;
    }
    friend bool operator!=(const RuleTable& a, const RuleTable& b) { return !(a == b); }

private:
    Map snapshot() const {
        ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_lock);
        return m_rules;
    }

    mutable ACE_RW_Thread_Mutex m_lock;
    Map m_rules;
};

}  // namespace Configuration
