// Configuration::VariationPointConfiguration__: the variation-point section ("VariationPoint") of
// the per-machine system document: two points where a site may depart from the standard
// behaviour, the auto-delete strategy and the list of storage services offered.
//
// Keys in order, with defaults: "AutoDeleteStrategy" (string, empty: the standard strategy),
// "StorageCommitServiceList" (i32, 0: "All_Storage_Services_List", storage commitment offered;
// 1 selects "All_Storage_Services_List_NO_STORAGE_COMMITMENT_PUSH").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API VariationPointConfiguration__ : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(VariationPointConfiguration__);

public:
    // Name of the auto-delete strategy; empty for the standard one.
    const ACE_CString& getAutoDeleteStrategy() const { return m_autoDeleteStrategy; }
    void setAutoDeleteStrategy(const ACE_CString& value) { m_autoDeleteStrategy = value; }
    // Which storage service list is offered: 0 or 1.
    int getStorageCommitServiceList() const { return m_storageCommitServiceList; }
    void setStorageCommitServiceList(int value) { m_storageCommitServiceList = value; }

    // The name of the selected storage service list; empty (and an error logged) when the stored
    // number is neither 0 nor 1.
    ACE_CString getStorageCommitServiceListValue() const;
    // True when text names neither of the two standard storage service lists.
    static bool isStorageCommitServiceListValueCustom(const ACE_CString& text);

private:
    ACE_CString m_autoDeleteStrategy;
    int m_storageCommitServiceList = 0;
};

}  // namespace Configuration
