// Filter tags and the list of them. Both are read-only.
#include "Configuration/FilterTag.h"

#include "Configuration/FilterTagList.h"
#include "ListReserve.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void FilterTag::fields(Self& self, Io& io) {
    io("Tag", self.m_tag);
    io("TagName", Fields::optional(self.m_tagName));
    io("SOPClassUID", Fields::optional(self.m_sopClassUID));
    io("SOPClassName", Fields::optional(self.m_sopClassName));
    io("Additional", Fields::optional(self.m_additional, false));
}

CONFIGURATION_DEFINE_READ(FilterTag, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_NO_WRITE(FilterTag, "FilterTag::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(FilterTag)

template <class Self, class Io>
void FilterTagList::fields(Self& self, Io& io) {
    io(FilterTag::WELL_KNOWN_NAME, Fields::items(self.m_tags, Fields::Append));
}

DICOM_LIST_DEFINE_READ(FilterTagList, m_tags, FilterTag::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_NO_WRITE(FilterTagList, "FilterTagList::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(FilterTagList)

}  // namespace Configuration
