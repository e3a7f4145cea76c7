// Configuration::DicomClientConfiguration: the site-wide document "DicomClient": the SOP classes
// whose objects the viewing client may display, keyed by SOP class UID.
//
// Element "DicomClient" with one child "ViewableSOPClasses" holding one "SOPClass" ("name",
// "uid") per class. Reading takes "ViewableSOPClasses" (its absence is a read failure, logged),
// empties the map and stores each class that reads complete under its uid, a later class
// replacing an earlier one with the same uid; a class without "name" or "uid" is dropped and
// makes the read incomplete. Writing gives the classes in the order of their UIDs.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <unordered_map>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/SOPClass.h"
#include "Configuration/StringHash.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API DicomClientConfiguration : public TypedConfigDoc<DicomClientConfiguration> {
    CONFIGURATION_CLASS(DicomClientConfiguration);

public:
    // The viewable SOP classes by UID.
    using SOPClassMap = std::unordered_map<ACE_CString, SOPClass, StringHash>;

    static constexpr const char WELL_KNOWN_NAME[] = "DicomClient";

    // The site-wide document "DicomClient" with no viewable class.
    DicomClientConfiguration();

    // The viewable SOP classes, keyed by UID.
    const SOPClassMap& getViewableSopClasses() const { return m_viewable; }
    void setViewableSopClasses(const SOPClassMap& classes) { m_viewable = classes; }

    // True exactly when the SOP class uid (whole, case-sensitive) is viewable.
    bool IsSopClassViewable(const ACE_CString& uid) const;

private:
    SOPClassMap m_viewable;
};

}  // namespace Configuration
