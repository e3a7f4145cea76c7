#include "Configuration/RestartConfiguration__.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void RestartConfiguration__::fields(Self& self, Io& io) {
    io("RestartTimeOfDay", self.m_restartTimeOfDay);
    io("RestartNumberOfDaysBetween", self.m_restartNumberOfDaysBetween);
}

CONFIGURATION_DEFINE(RestartConfiguration__, "Restart", Fields::FailureForm::PartialDefaults)

}  // namespace Configuration
