#include "Configuration/SolutionDefinition.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void SolutionDefinition::fields(Self& self, Io& io) {
    io("Name", self.m_name);
    io("DataPath", self.m_dataPath);
}

CONFIGURATION_DEFINE(SolutionDefinition, "Solution", Fields::FailureForm::PartialDefaults)

}  // namespace Configuration
