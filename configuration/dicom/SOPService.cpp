// SOP services and the list of them. Both are read-only; a service's template name and resolved
// syntaxes are built by the SOP service document after reading.
#include "Configuration/SOPService.h"

#include "Configuration/SOPServiceList.h"
#include "ListReserve.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void SOPService::fields(Self& self, Io& io) {
    io("UID", self.m_uid);
    io("Name", self.m_name);
    io("Description", Fields::optional(self.m_description));
    io("ObjectType", Fields::text(self.m_objectType, &SOPService::Str2SOPObjectType,
                                  &SOPService::SOPObjectType2Str));
    io("Additional", Fields::optional(self.m_additional, false));
    io("EnabledDefault", Fields::optional(self.m_enabledDefault, true));
    io("Enabled", Fields::optional(self.m_enabled, self.m_enabledDefault));
    io("TemplateName", Fields::derived(self.m_templateName));
    io("TxListDefault", Fields::uncompared(Fields::optional(self.m_defaultListText)));
    io("TxList",
       Fields::uncompared(
           Fields::optional(self.m_modificationListText).noting(self.m_hasModificationList)));
    io("TransferSyntaxList", Fields::derived(self.m_transferSyntaxList));
}

CONFIGURATION_DEFINE_READ(SOPService, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_NO_WRITE(SOPService, "SOPService::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(SOPService)

SOPObjectType SOPService::Str2SOPObjectType(ACE_CString text) {
    static const struct {
        const char* text;
        SOPObjectType type;
    } kNamed[] = {
        {SOPObjectTypeText::kGSPS, SOPObjectTypeGSPS},
        {SOPObjectTypeText::kSR, SOPObjectTypeSR},
        {SOPObjectTypeText::kKO, SOPObjectTypeKO},
        {SOPObjectTypeText::kPrivate, SOPObjectTypePrivate},
        {SOPObjectTypeText::kCSPS, SOPObjectTypeCSPS},
    };
    for (const auto& named : kNamed) {
        if (text == named.text) {
            return named.type;
        }
    }
    return SOPObjectTypeImage;  // also for "SPECIAL", which names no kind of its own
}

ACE_CString SOPService::SOPObjectType2Str(SOPObjectType type) {
    return sopObjectTypeText(type);
}

template <class Self, class Io>
void SOPServiceList::fields(Self& self, Io& io) {
    io(SOPService::WELL_KNOWN_NAME, Fields::items(self.m_services, Fields::Append));
}

DICOM_LIST_DEFINE_READ(SOPServiceList, m_services, SOPService::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_NO_WRITE(SOPServiceList, "SOPServiceList::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(SOPServiceList)

}  // namespace Configuration
