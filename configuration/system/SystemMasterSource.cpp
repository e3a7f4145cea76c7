// The machine's master source: the master configuration host named by its system document.
#include "Configuration/ConfigurationRepository.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Quorvex/Log.h"
#include "repository/MasterSource.h"

namespace Configuration {
namespace {

class SystemMasterSource : public MasterSource {
public:
    // Reads the system document afresh; a read that fails, even part-way, names no master, so a
    // half-read document never redirects the writes.
    ACE_CString masterHostName(ConfigurationRepository& repository) const override {
        OrvelSystemConfiguration system;
        if (repository.GetLatest(system, true) != 0) {
            QUORVEX_LOG(LM_DEBUG,
                        "ConfigurationRepository::instance: no system configuration; this machine "
                        "is its own master\n");
            return ACE_CString();
        }
        return system.getMasterConfigurationServiceHostName();
    }
};

}  // namespace

const MasterSource& machineMasterSource() {
    static const SystemMasterSource source;
    return source;
}

}  // namespace Configuration
