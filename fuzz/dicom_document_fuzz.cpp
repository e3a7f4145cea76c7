// The DICOM provider, export, automatic export and query documents fed arbitrary XML: each
// document class reads whatever tree the XML reader accepts without throwing; what a writable
// one writes reads back complete, and equal when its own read was complete; the read-only rules
// read, copy equal, answer look-ups and refuse to write. Any mismatch aborts.
#include "ClassFuzz.h"
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

namespace {

void rules(const Vesk::Element& tree) {
    Configuration::AutoExportConfiguration config;
    config.readVesk(tree);
    ClassFuzz::copiesEqual(config);
    for (const auto& rule : config.getRules()) {
        for (const auto& destination : rule.getDestinations()) {
            if (!config.isDestinationUsed(destination.GetDestinationName())) {
                std::abort();
            }
        }
    }
    ClassFuzz::refusesWrite(config);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Vesk::Element tree;
    if (!ClassFuzz::parse(data, size, tree)) {
        return 0;
    }
    using namespace Configuration;
    ClassFuzz::readWriteReadAll<SSCPConfiguration, QrscpConfiguration, StorageCommitConfiguration,
                                KelExportGlobalConfiguration, KelExportConfigurationAdapter,
                                KelExportLocalConfiguration, KelExportRemoteConfigurations,
                                KelExportWebService, KelQueryConfiguration>(tree);
    rules(tree);
    return 0;
}
