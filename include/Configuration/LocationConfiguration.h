// Configuration::LocationConfiguration: the site-wide document "Location" (element
// "LocationConfiguration"): the site's locations, key "LocationProfiles" holding one
// "LocationProfile" per location, in order (an item that does not read complete is kept and
// makes the read incomplete). It answers which profile a host belongs to and which is the main
// one.
// The document owns its profiles: they are created when added or read, destroyed when removed,
// cleared or with the document; pointers it returns stay valid until their profile is removed.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <list>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/LocationProfile.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API LocationConfiguration : public TypedConfigDoc<LocationConfiguration> {
    CONFIGURATION_CLASS(LocationConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "LocationConfiguration";
    using Profiles = std::list<LocationProfile>;

    // Where a host is, seen from a location (MapHostToLocationProfile).
    enum HostLocation : int {
        SameNetwork = 0,       // on the location's own network
        OtherNetwork = 1,      // across the boundary between the site's LAN and a WAN
        OtherWanLocation = 2,  // at another location on the WAN
        UnknownLocation = 3,   // in no location, or the location's network is not known
    };

    // The site-wide document "Location" without locations.
    LocationConfiguration();

    // The profiles, in order.
    const Profiles& getLocationProfiles() const { return m_profiles; }
    // The first profile named name (exactly), or null.
    LocationProfile* getLocationProfileByName(const ACE_CString& name);
    const LocationProfile* getLocationProfileByName(const ACE_CString& name) const;
    // The first profile listing host (ignoring case), or null.
    const LocationProfile* getLocationProfileByServer(const ACE_CString& host) const;
    // The first profile of type main location, or null.
    const LocationProfile* getMainCalyraProfile() const;
    // Where host is seen from profile (see HostLocation); UnknownLocation for a null profile.
    HostLocation MapHostToLocationProfile(const LocationProfile* profile,
                                          const ACE_CString& host) const;
    // Appends a copy of profile; 1, or 0 when the copy could not be made.
    int AddNewProfile(const LocationProfile& profile);
    // Replaces the profile of the same name with a copy of profile, or appends one.
    void setLocationProfile(const LocationProfile& profile);
    // Removes and destroys the first profile named name (exactly).
    void removeLocationProfile(const ACE_CString& name);
    // Removes and destroys every profile.
    void ClearAll() { m_profiles.clear(); }

private:
    Profiles m_profiles;
};

}  // namespace Configuration
