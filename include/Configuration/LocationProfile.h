// Configuration::LocationProfile: one location of the site (the main site, or a remote site
// reached over a LAN segment or a WAN): its servers, image compression, prefetching, work list,
// forwarding and how it is reached. Element "LocationProfile"; keys in written order with
// defaults: "ProfileName" "NewLocation", "LocalServers" (repeated, host names) empty,
// "NewExamImageQuality" 0, "PriorExamImageQuality" 0, "LocationType" 1, "PrefetchImages" false,
// "InternalWorkListHost" "", "RouteToLocation" "", "NetworkAffiliation" 0, "CollectionMode" 0,
// "CollectIpFilters" (repeated) empty, "MergeTraceLevels" (repeated numbers, a set) empty,
// "EnableForwarding" false, "ForwardingDestinations" ("KelExportRemoteScp" items; one that does
// not read complete is left out) empty, "EnableMergeNetworkCapture" false,
// "MergeNetworkCaptureShutOffTimer" 30 (minutes), "MergeNetworkCapturedFileRetentionTime" 7
// (days), "DicomModalityWorkListPort" "8104".
// Plain value owned by its caller (LocationConfiguration owns its profiles); not thread-safe.
#pragma once

#include <ace/SString.h>

#include <set>
#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/KelExportRemoteScp.h"

namespace Configuration {

class CONFIGURATION_API LocationProfile : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(LocationProfile);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "LocationProfile";

    // What kind of location this is (any number a document holds is kept).
    enum LocationType : int {
        MainLocation = 0,     // the main site
        RemoteLocation = 1,   // a remote site on the site's own network
        RemoteWanAccess = 2,  // a remote site reached over a WAN
        RemoteWanCached = 3,  // a remote site reached over a WAN, with its own cache
    };
    // Which network the location is on (any number a document holds is kept).
    enum NetworkAffiliation : int {
        Vlan = 0,  // the site's own (virtual) LAN
        Wan = 1,   // a wide-area network
    };

    // The location's name (compared exactly).
    const ACE_CString& getProfileName() const { return m_name; }
    void setProfileName(const ACE_CString& name) { m_name = name; }
    // The servers of the location.
    const std::vector<ACE_CString>& getLocalServers() const { return m_servers; }
    void setLocalServers(const std::vector<ACE_CString>& servers) { m_servers = servers; }
    void addLocalServer(const ACE_CString& host) { m_servers.push_back(host); }
    // Removes the first server equal to host, ignoring case.
    void removeLocalServer(const ACE_CString& host);
    void removeAllServers() { m_servers.clear(); }
    // Whether any server equals host, ignoring case.
    bool hasServer(const ACE_CString& host) const;
    // Image quality of new exams (0: uncompressed).
    int getNewExamImageQuality() const { return m_newQuality; }
    void setNewExamImageQuality(int quality) { m_newQuality = quality; }
    // Image quality of prior exams (0: uncompressed).
    int getPriorExamImageQuality() const { return m_priorQuality; }
    void setPriorExamImageQuality(int quality) { m_priorQuality = quality; }
    // Whether images are compressed for the location.
    bool IsCompressionEnabled() const { return m_newQuality >= 1 || m_priorQuality >= 1; }
    // The location's kind.
    LocationType getType() const { return m_type; }
    void setType(LocationType type) { m_type = type; }
    // Whether this is the main location.
    bool IsMainCalyra() const { return m_type == MainLocation; }
    // Whether the location is reached over a WAN.
    bool IsRemoteWANAccess() const {
        return m_type == RemoteWanAccess || m_type == RemoteWanCached;
    }
    // Whether images are prefetched for the location.
    bool IsPrefetchingImagesEnabled() const { return m_prefetch; }
    void EnablePrefetchingImages(bool enable) { m_prefetch = enable; }
    // The host of the location's internal work list.
    const ACE_CString& getInternalWorkListHost() const { return m_workListHost; }
    void setInternalWorkListHost(const ACE_CString& host) { m_workListHost = host; }
    // The location studies are routed to.
    const ACE_CString& getRouteToLocation() const { return m_routeTo; }
    void setRouteToLocation(const ACE_CString& location) { m_routeTo = location; }
    // The location's network.
    NetworkAffiliation getNetworkAffiliation() const { return m_affiliation; }
    void setNetworkAffiliation(NetworkAffiliation affiliation) { m_affiliation = affiliation; }
    // Whether the location is on the site's own network.
    bool IsVLAN() const { return m_affiliation == Vlan; }
    // Whether the location is on a WAN.
    bool IsWAN() const { return m_affiliation == Wan; }
    // How studies are collected at the location.
    int getCollectionMode() const { return m_collectionMode; }
    void setCollectionMode(int mode) { m_collectionMode = mode; }
    // The addresses collection admits (none: all).
    const std::vector<ACE_CString>& getIpFilters() const { return m_ipFilters; }
    void addIpFilter(const ACE_CString& filter) { m_ipFilters.push_back(filter); }
    // Removes every filter equal to filter.
    void removeIpFilter(const ACE_CString& filter);
    // Whether filter is admitted: no filters admit everything, else an exact match.
    bool hasFilter(const ACE_CString& filter) const;
    // The trace levels of network capture merging.
    const std::set<int>& getMergeTraceLevels() const { return m_traceLevels; }
    void setMergeTraceLevels(const std::set<int>& levels) { m_traceLevels = levels; }
    // Whether studies are forwarded from the location.
    bool getEnableForwarding() const { return m_forwarding; }
    void setEnableForwarding(bool enable) { m_forwarding = enable; }
    // Where studies are forwarded.
    const std::vector<KelExportRemoteScp>& getForwardDestinations() const { return m_destinations; }
    void addForwardDestination(const KelExportRemoteScp& destination) {
        m_destinations.push_back(destination);
    }
    // Removes every destination equal to destination.
    void removeForwardDestination(const KelExportRemoteScp& destination);
    // Whether network capture merging is on.
    bool isMergeNetworkCaptureEnabled() const { return m_captureEnabled; }
    void enableMergeNetworkCapture(bool enable) { m_captureEnabled = enable; }
    // Minutes after which network capture stops by itself.
    int getMergeNetworkCaptureShutOffTimer() const { return m_captureShutOff; }
    void setMergeNetworkCaptureShutOffTimer(int minutes) { m_captureShutOff = minutes; }
    // Days captured files are kept.
    int getMergeNetworkCapturedFileRetentionTime() const { return m_captureRetention; }
    void setMergeNetworkCapturedFileRetentionTime(int days) { m_captureRetention = days; }
    // The DICOM modality work-list port, as text.
    const ACE_CString& GetDmwlPort() const { return m_dmwlPort; }
    void SetDmwlPort(const ACE_CString& port) { m_dmwlPort = port; }

private:
    ACE_CString m_name = "NewLocation";
    std::vector<ACE_CString> m_servers;
    int m_newQuality = 0;
    int m_priorQuality = 0;
    LocationType m_type = RemoteLocation;
    bool m_prefetch = false;
    ACE_CString m_workListHost;
    ACE_CString m_routeTo;
    NetworkAffiliation m_affiliation = Vlan;
    int m_collectionMode = 0;
    std::vector<ACE_CString> m_ipFilters;
    std::set<int> m_traceLevels;
    bool m_forwarding = false;
    std::vector<KelExportRemoteScp> m_destinations;
    bool m_captureEnabled = false;
    int m_captureShutOff = 30;
    int m_captureRetention = 7;
    ACE_CString m_dmwlPort = "8104";
};

}  // namespace Configuration
