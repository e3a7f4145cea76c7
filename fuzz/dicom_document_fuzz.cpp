// The DICOM provider, export, automatic export and query documents fed arbitrary XML: each
// document class reads whatever tree the XML reader accepts without throwing; what a writable
// one writes reads back complete, and equal when its own read was complete; the read-only rules
// read, copy equal, answer look-ups and refuse to write. Any mismatch aborts.
#include <ace/Log_Msg.h>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>

#include "Configuration/AutoExportConfiguration.h"
#include "Configuration/KelExportConfigurationAdapter.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/KelQueryConfiguration.h"
#include "Configuration/QrscpConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "Configuration/StorageCommitConfiguration.h"
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

void rules(const Vesk::Element& tree) {
    Configuration::AutoExportConfiguration config;
    config.readVesk(tree);
    const Configuration::AutoExportConfiguration copy = config;
    if (!(copy == config)) {
        std::abort();
    }
    for (const auto& rule : config.getRules()) {
        for (const auto& destination : rule.getDestinations()) {
            if (!config.isDestinationUsed(destination.GetDestinationName())) {
                std::abort();
            }
        }
    }
    try {
        config.writeVesk();
    } catch (const std::exception&) {
        return;
    }
    std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const bool quiet = [] {  // read failures are expected here; logging them only slows
        ACE_LOG_MSG->priority_mask(LM_CRITICAL, ACE_Log_Msg::PROCESS);
        return true;
    }();
    (void)quiet;
    Vesk::Element tree;
    try {
        Vesk::XmlUtils::parse(reinterpret_cast<const char*>(data), size, tree);
    } catch (const std::exception&) {
        return 0;  // refused cleanly
    }
    readWriteRead<Configuration::SSCPConfiguration>(tree);
    readWriteRead<Configuration::QrscpConfiguration>(tree);
    readWriteRead<Configuration::StorageCommitConfiguration>(tree);
    readWriteRead<Configuration::KelExportGlobalConfiguration>(tree);
    readWriteRead<Configuration::KelExportConfigurationAdapter>(tree);
    readWriteRead<Configuration::KelExportLocalConfiguration>(tree);
    readWriteRead<Configuration::KelExportRemoteConfigurations>(tree);
    readWriteRead<Configuration::KelExportWebService>(tree);
    readWriteRead<Configuration::KelQueryConfiguration>(tree);
    rules(tree);
    return 0;
}
