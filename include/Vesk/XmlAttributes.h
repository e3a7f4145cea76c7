// Vesk::XmlAttributes: the attributes of one element written by XmlEmitter, in order.
#pragma once

#include <ace/SString.h>

#include <utility>
#include <vector>

namespace Vesk {

class XmlAttributes {
public:
    // Appends an attribute.
    void add(const ACE_CString& name, const ACE_CString& value) {
        m_items.emplace_back(name, value);
    }
    const std::vector<std::pair<ACE_CString, ACE_CString>>& items() const { return m_items; }
    bool empty() const { return m_items.empty(); }

private:
    std::vector<std::pair<ACE_CString, ACE_CString>> m_items;
};

}  // namespace Vesk
