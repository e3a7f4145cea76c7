#include "Configuration/DicomClientConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

constexpr const char kViewableSOPClasses[] = "ViewableSOPClasses";

}  // namespace

template <class Self, class Io>
void DicomClientConfiguration::fields(Self& self, Io& io) {
    io(kViewableSOPClasses, Fields::wrapped(SOPClass::WELL_KNOWN_NAME, self.m_viewable,
                                            Fields::DropFailed, &SOPClass::getUid));
}

CONFIGURATION_DEFINE_WRITE(DicomClientConfiguration, DicomClientConfiguration::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_EQUAL(DicomClientConfiguration)

DicomClientConfiguration::DicomClientConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kDicomClient,
                     false) {}

// Takes the list first, so that a document without it is a logged failure that keeps the map.
bool DicomClientConfiguration::readVesk(const Vesk::Element& element) {
    try {
        const Vesk::Element& list =
            element.getMultiElement().getElement(Fields::keyOf(kViewableSOPClasses));
        m_viewable.clear();
        return Fields::readItems(
            m_viewable,
            Fields::KeyRange{list.getMultiElement(), Fields::keyOf(SOPClass::WELL_KNOWN_NAME)},
            Fields::DropFailed, Fields::ElementReader(),
            [](const SOPClass& sopClass) { return sopClass.getUid(); });
    } catch (const std::exception& e) {
        Fields::logReadFailure("DicomClientConfiguration", Fields::FailureForm::Failed, e.what());
        return false;
    }
}

bool DicomClientConfiguration::IsSopClassViewable(const ACE_CString& uid) const {
    return m_viewable.find(uid) != m_viewable.end();
}

}  // namespace Configuration
