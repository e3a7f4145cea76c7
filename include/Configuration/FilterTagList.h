// Configuration::FilterTagList: the filter tags of the SOP service document. Element
// "FilterTagList" with one child "FilterTag" per tag, in document order; every tag is kept, also
// one whose read was incomplete. Reading appends to what the list holds. Read-only: writeVesk
// throws std::exception ("FilterTagList::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/FilterTag.h"

namespace Configuration {

class CONFIGURATION_API FilterTagList : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(FilterTagList);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "FilterTagList";

    // The tags, in document order.
    const std::vector<FilterTag>& getFilterTags() const { return m_tags; }

private:
    std::vector<FilterTag> m_tags;
};

}  // namespace Configuration
