// The master table of transfer syntaxes: its rows and the list of them. Both are read-only.
#include "Configuration/SupportedTransferSyntax.h"

#include "Configuration/SupportedTransferSyntaxList.h"
#include "ListReserve.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void SupportedTransferSyntax::fields(Self& self, Io& io) {
    io("TxNr", self.m_nr);
    io("TxUID", self.m_uid);
    io("TxName", self.m_name);
    io("TxDescription", Fields::optional(self.m_description));
}

CONFIGURATION_DEFINE_READ(SupportedTransferSyntax, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_NO_WRITE(SupportedTransferSyntax,
                              "SupportedTransferSyntax::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(SupportedTransferSyntax)

template <class Self, class Io>
void SupportedTransferSyntaxList::fields(Self& self, Io& io) {
    io(SupportedTransferSyntax::WELL_KNOWN_NAME, Fields::items(self.m_rows, Fields::Append));
}

DICOM_LIST_DEFINE_READ(SupportedTransferSyntaxList, m_rows,
                       SupportedTransferSyntax::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_NO_WRITE(SupportedTransferSyntaxList,
                              "SupportedTransferSyntaxList::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(SupportedTransferSyntaxList)

}  // namespace Configuration
