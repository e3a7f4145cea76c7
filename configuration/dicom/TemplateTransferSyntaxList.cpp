// Transfer-syntax templates and the list of them. Both are read-only; the resolved syntaxes are
// built by the SOP service document after reading.
#include "Configuration/TemplateTransferSyntaxList.h"

#include "Configuration/TemplateTransferSyntaxLists.h"
#include "ListReserve.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void TemplateTransferSyntaxList::fields(Self& self, Io& io) {
    io("TemplateName", self.m_name);
    io("TemplateDescription", Fields::optional(self.m_description));
    io("Additional", Fields::optional(self.m_additional, false));
    io("TxList", Fields::uncompared(Fields::optional(self.m_listText)));
    io("TransferSyntaxList", Fields::derived(self.m_transferSyntaxList));
}

CONFIGURATION_DEFINE_READ(TemplateTransferSyntaxList, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_NO_WRITE(TemplateTransferSyntaxList,
                              "TemplateTransferSyntaxList::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(TemplateTransferSyntaxList)

template <class Self, class Io>
void TemplateTransferSyntaxLists::fields(Self& self, Io& io) {
    io(TemplateTransferSyntaxList::WELL_KNOWN_NAME,
       Fields::items(self.m_templates, Fields::Append));
}

DICOM_LIST_DEFINE_READ(TemplateTransferSyntaxLists, m_templates,
                       TemplateTransferSyntaxList::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_NO_WRITE(TemplateTransferSyntaxLists,
                              "TemplateTransferSyntaxLists::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(TemplateTransferSyntaxLists)

}  // namespace Configuration
