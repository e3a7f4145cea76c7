// Configuration::KelArchiveConfiguration: the site-wide document "KelArchive" (element
// "KelArchiveConfiguration"): the tape-archive servers, the archive nodes, which storage stack is
// archived through which node and file space, and the archive schedule.
//
// Keys in order with defaults:
//   "TivoliServers"                 "TivoliServerInfo" items by address (required: a document
//                                   without it fails to read, "No Tivoli servers element found")
//   "ArchiveNodesConfiguration"     "ArchiveLocalNodeInfo" items by node name
//   "ArchiveNodeStacksConfiguration" "ArchiveNodeStackInfo" items by stack UID
//   "TivoliServerDeletionTimeout"   172800 (seconds: two days)
//   "TivoliServerArchiveTimeOfDay"  "02:00" (hh:mm, local time)
//   "TivoliServerArchiveDelayTime"  20
//   "SqlBackupDirectory"            "D:\Quorvex\SQLBACKUP\"
//   "ArchivingSystem"               true
//   "VerifyStudyExistsOnPersistentServer" true
//   "DisableArchiveRequests"        false
// The maps are kept in key order; a later item with the same key replaces an earlier one. A
// server item missing one of its four keys, or a node item without its name, fails the whole
// read with a message naming what is missing (never the password).
// Plain value owned by its caller; not thread-safe. The look-ups throw
// ArchiveNotConfiguredException when they miss.
#pragma once

#include <ace/SString.h>

#include <map>

#include "Configuration/ArchiveLocalNodeInfo.h"
#include "Configuration/ArchiveNodeStackInfo.h"
#include "Configuration/ArchiveNotConfiguredException.h"
#include "Configuration/ConfigurationClass.h"
#include "Configuration/TivoliServerInfo.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelArchiveConfiguration : public TypedConfigDoc<KelArchiveConfiguration> {
    CONFIGURATION_CLASS(KelArchiveConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelArchiveConfiguration";
    using Servers = std::map<ACE_CString, TivoliServerInfo>;
    using Nodes = std::map<ACE_CString, ArchiveLocalNodeInfo>;
    using Stacks = std::map<ACE_CString, ArchiveNodeStackInfo>;

    // The site-wide document "KelArchive" with no server, node or stack.
    KelArchiveConfiguration();

    // The servers by address.
    const Servers& getTivoliServers() const { return m_servers; }
    void setTivoliServers(const Servers& servers) { m_servers = servers; }
    // The archive nodes by name.
    const Nodes& getArchiveNodes() const { return m_nodes; }
    void setArchiveNodes(const Nodes& nodes) { m_nodes = nodes; }
    // The archived stacks by UID.
    const Stacks& getArchiveStacks() const { return m_stacks; }
    void setArchiveStacks(const Stacks& stacks) { m_stacks = stacks; }
    // Seconds before archived studies are deleted.
    unsigned int getDeletionTimeout() const { return m_deletionTimeout; }
    void setDeletionTimeout(unsigned int seconds) { m_deletionTimeout = seconds; }
    // The time of day archiving runs ("hh:mm").
    const ACE_CString& getArchiveTimeOfDay() const { return m_timeOfDay; }
    void setArchiveTimeOfDay(const ACE_CString& time) { m_timeOfDay = time; }
    // How long a study waits before it is archived.
    unsigned int getArchiveDelayTime() const { return m_delay; }
    void setArchiveDelayTime(unsigned int delay) { m_delay = delay; }
    // Where database backups are written.
    const ACE_CString& getSQLBackupDirectory() const { return m_sqlBackup; }
    void setSQLBackupDirectory(const ACE_CString& directory) { m_sqlBackup = directory; }
    // Whether this site archives at all.
    bool isArchivingSystem() const { return m_archiving; }
    void setArchivingSystem(bool archiving) { m_archiving = archiving; }
    // Whether a study must exist on the persistent server before it is archived.
    bool VerifyStudyExistsOnPersistentServer() const { return m_verify; }
    void setVerifyStudyExistsOnPersistentServer(bool verify) { m_verify = verify; }
    // Whether archive requests are refused.
    bool getDisableArchiveRequests() const { return m_disableRequests; }
    void setDisableArchiveRequests(bool disable) { m_disableRequests = disable; }

    // The server whose address is exactly address.
    const TivoliServerInfo& getTivoliServerInfoByAddress(const ACE_CString& address) const;
    // The node named name.
    const ArchiveLocalNodeInfo& getArchiveNodeInfo(const ACE_CString& name) const;
    // How stackUid is archived.
    const ArchiveNodeStackInfo& getArchiveStackInfo(const ACE_CString& stackUid) const;
    // The server at tivoliServer; when that is not configured (logged), the server of
    // localNodeName's default settings instead, else "Unable to find Tivoli server info for "
    // + localNodeName.
    const TivoliServerInfo& getTivoliServerInfo(const ACE_CString& localNodeName,
                                                const ACE_CString& tivoliServer) const;

private:
    Servers m_servers;
    Nodes m_nodes;
    Stacks m_stacks;
    unsigned int m_deletionTimeout = 172800;
    ACE_CString m_timeOfDay = "02:00";
    unsigned int m_delay = 20;
    ACE_CString m_sqlBackup = "D:\\Quorvex\\SQLBACKUP\\";
    bool m_archiving = true;
    bool m_verify = true;
    bool m_disableRequests = false;
};

}  // namespace Configuration
