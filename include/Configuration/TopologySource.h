// Configuration::TopologySource: where the storage-topology queries of MSMQCommonConfiguration
// find the documents they combine (the strategy and location documents) and whom they ask
// whether the site has storage stacks. The process's source is, by default, the process's
// ConfigurationRepository for documents and this machine's configuration service (as
// ServiceLocation gives it) for hosts; a test or a tool installs another one with
// ScopedTopologySource.
// Implementations must be thread-safe: queries on several threads call them at once. Installing
// a source is not synchronised with queries running at that moment: install before querying.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/Export.h"

namespace Configuration {

class ConfigDoc;

class CONFIGURATION_API TopologySource {
public:
    virtual ~TopologySource();
    // Fills document with its latest stored state; 0 on success, -1 (document unchanged) else.
    virtual int load(ConfigDoc& document) const = 0;
    // The hosts of the site that run a module of moduleType; throws std::exception when the
    // service cannot be asked.
    virtual void hostsOfModuleType(int moduleType, std::vector<ACE_CString>& hosts) const = 0;
};

// The source the queries use now.
CONFIGURATION_API const TopologySource& topologySource();

// Installs source for its lifetime (the caller keeps it alive), then puts the previous back.
class CONFIGURATION_API ScopedTopologySource {
public:
    explicit ScopedTopologySource(const TopologySource& source);
    ~ScopedTopologySource();
    ScopedTopologySource(const ScopedTopologySource&) = delete;
    ScopedTopologySource& operator=(const ScopedTopologySource&) = delete;

private:
    const TopologySource* m_previous;
};

}  // namespace Configuration
