#include "Configuration/VariationPointConfiguration__.h"

#include "Quorvex/Log.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

// The storage service lists selected by 0 and 1.
const char kAllStorageServices[] = "All_Storage_Services_List";
const char kNoStorageCommitmentPush[] = "All_Storage_Services_List_NO_STORAGE_COMMITMENT_PUSH";

}  // namespace

template <class Self, class Io>
void VariationPointConfiguration__::fields(Self& self, Io& io) {
    io("AutoDeleteStrategy", self.m_autoDeleteStrategy);
    io("StorageCommitServiceList", self.m_storageCommitServiceList);
}

CONFIGURATION_DEFINE(VariationPointConfiguration__, "VariationPoint",
                     Fields::FailureForm::PartialDefaults)

ACE_CString VariationPointConfiguration__::getStorageCommitServiceListValue() const {
    switch (m_storageCommitServiceList) {
        case 0:
            return ACE_CString(kAllStorageServices);
        case 1:
            return ACE_CString(kNoStorageCommitmentPush);
        default:
            QUORVEX_LOG(LM_ERROR,
                        "VariationPointConfiguration__::getStorageCommitServiceListValue(): Failed "
                        "- configuration has invalid value for storage commit service list.\n");
            return ACE_CString();
    }
}

bool VariationPointConfiguration__::isStorageCommitServiceListValueCustom(const ACE_CString& text) {
    return text != kAllStorageServices && text != kNoStorageCommitmentPush;
}

}  // namespace Configuration
