#include "Configuration/LocationConfiguration.h"

#include <new>

#include "Configuration/DocumentNames.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void LocationConfiguration::fields(Self& self, Io& io) {
    io("LocationProfiles", Fields::wrapped(LocationProfile::WELL_KNOWN_NAME, self.m_profiles));
}

CONFIGURATION_DEFINE(LocationConfiguration, LocationConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

LocationConfiguration::LocationConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kLocation, false) {}

LocationProfile* LocationConfiguration::getLocationProfileByName(const ACE_CString& name) {
    for (LocationProfile& profile : m_profiles) {
        if (profile.getProfileName() == name) {
            return &profile;
        }
    }
    return nullptr;
}

const LocationProfile* LocationConfiguration::getLocationProfileByName(
    const ACE_CString& name) const {
    return const_cast<LocationConfiguration*>(this)->getLocationProfileByName(name);
}

const LocationProfile* LocationConfiguration::getLocationProfileByServer(
    const ACE_CString& host) const {
    for (const LocationProfile& profile : m_profiles) {
        if (profile.hasServer(host)) {
            return &profile;
        }
    }
    return nullptr;
}

const LocationProfile* LocationConfiguration::getMainCalyraProfile() const {
    for (const LocationProfile& profile : m_profiles) {
        if (profile.IsMainCalyra()) {
            return &profile;
        }
    }
    return nullptr;
}

LocationConfiguration::HostLocation LocationConfiguration::MapHostToLocationProfile(
    const LocationProfile* profile, const ACE_CString& host) const {
    const LocationProfile* found = getLocationProfileByServer(host);
    if (found == nullptr || profile == nullptr) {
        return UnknownLocation;
    }
    switch (profile->getNetworkAffiliation()) {
        case LocationProfile::Vlan:
            return found->IsVLAN() ? SameNetwork : OtherNetwork;
        case LocationProfile::Wan:
            if (found->IsVLAN()) {
                return OtherNetwork;
            }
            return profile->hasServer(host) ? SameNetwork : OtherWanLocation;
    }
    return UnknownLocation;
}

int LocationConfiguration::AddNewProfile(const LocationProfile& profile) {
    try {
        m_profiles.push_back(profile);
        return 1;
    } catch (const std::bad_alloc&) {
        return 0;
    }
}

void LocationConfiguration::setLocationProfile(const LocationProfile& profile) {
    LocationProfile* existing = getLocationProfileByName(profile.getProfileName());
    if (existing != nullptr) {
        *existing = profile;
    } else {
        m_profiles.push_back(profile);
    }
}

void LocationConfiguration::removeLocationProfile(const ACE_CString& name) {
    for (auto it = m_profiles.begin(); it != m_profiles.end(); ++it) {
        if (it->getProfileName() == name) {
            m_profiles.erase(it);
            return;
        }
    }
}

}  // namespace Configuration
