#include "Fields.h"
#include "Quorvex/Log.h"

namespace Configuration {
namespace Fields {

void logReadFailure(const char* className, FailureForm form, const char* what) {
    switch (form) {
        case FailureForm::Failed:
            QUORVEX_LOG(LM_ERROR, "%s::readVesk: Failed. Standard Exception: %s\n", className,
                        what);
            break;
        case FailureForm::PartialDefaults:
            QUORVEX_LOG(LM_ERROR,
                        "%s::readVesk: Failed - Using partial defaults. Standard Exception: %s.\n",
                        className, what);
            break;
        case FailureForm::PartialDefaultsNoStop:
            QUORVEX_LOG(LM_ERROR,
                        "%s::readVesk: Failed - Using partial defaults. Standard Exception: %s\n",
                        className, what);
            break;
    }
}

}  // namespace Fields
}  // namespace Configuration
