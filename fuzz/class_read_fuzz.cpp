// Configuration classes fed arbitrary XML: every class (and the convention's test class, which has
// a field of every form) reads whatever tree the XML reader accepts. What an object writes must
// read back complete, and equal to it when its own read was complete (a read cut short by a
// failure leaves derived data unresolved). readVesk never throws; any mismatch aborts.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>

#include "Configuration/AnonParam.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "ConventionSample.h"
#include "Vesk/XmlUtils.h"

namespace {

template <class T>
void readWriteRead(const Vesk::Element& tree) {
    T first;
    const bool complete = first.readVesk(tree);
    T second;
    if (!second.readVesk(*first.writeVesk()) || (complete && !(first == second))) {
        std::abort();
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Vesk::Element tree;
    try {
        Vesk::XmlUtils::parse(reinterpret_cast<const char*>(data), size, tree);
    } catch (const std::exception&) {
        return 0;  // refused cleanly
    }
    readWriteRead<Configuration::AnonParam>(tree);
    readWriteRead<Configuration::RestartConfiguration__>(tree);
    readWriteRead<Configuration::VariationPointConfiguration__>(tree);
    readWriteRead<Configuration::StackConfiguration__>(tree);
    readWriteRead<Configuration::OrvelSystemConfiguration>(tree);
    readWriteRead<Configuration::Testing::Convention>(tree);
    return 0;
}
