// The stored-form decoder fed arbitrary bytes: inflate, parse, then let configuration classes read
// whatever tree came out. Only the decoder's own exceptions may escape; readVesk never throws.
#include <cstddef>
#include <cstdint>
#include <exception>

#include "Configuration/AnonParam.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Configuration/StoredForm.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Vesk::Element tree;
    try {
        Configuration::StoredForm::decode(data, size, tree);
    } catch (const std::exception&) {
        return 0;  // refused cleanly
    }
    Configuration::AnonParam param;
    param.readVesk(tree);
    Configuration::OrvelSystemConfiguration system;
    system.readVesk(tree);
    return 0;
}
