#include "Configuration/SOPClass.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void SOPClass::fields(Self& self, Io& io) {
    io("name", self.m_name);
    io("uid", self.m_uid);
}

CONFIGURATION_DEFINE(SOPClass, SOPClass::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

}  // namespace Configuration
