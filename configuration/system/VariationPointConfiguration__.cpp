#include "Configuration/VariationPointConfiguration__.h"

#include "Quorvex/Log.h"
#include "model/Fields.h"

namespace Configuration {
namespace {

const char kElement[] = "VariationPoint";
// The storage service lists selected by 0 and 1.
const char kAllStorageServices[] = "All_Storage_Services_List";
const char kNoStorageCommitmentPush[] = "All_Storage_Services_List_NO_STORAGE_COMMITMENT_PUSH";

}  // namespace

template <class Self, class Io>
void VariationPointConfiguration__::fields(Self& self, Io& io) {
    io("AutoDeleteStrategy", self.m_autoDeleteStrategy);
    io("StorageCommitServiceList", self.m_storageCommitServiceList);
}

VariationPointConfiguration__::VariationPointConfiguration__() = default;
VariationPointConfiguration__::VariationPointConfiguration__(
    const VariationPointConfiguration__& other) = default;
VariationPointConfiguration__& VariationPointConfiguration__::operator=(
    const VariationPointConfiguration__& other) = default;
VariationPointConfiguration__::~VariationPointConfiguration__() = default;

bool VariationPointConfiguration__::readVesk(const Vesk::Element& element) {
    return Fields::read(*this, element, "VariationPointConfiguration__",
                        Fields::FailureForm::PartialDefaults);
}

Quorvex::auto_ptr<Vesk::Element> VariationPointConfiguration__::writeVesk() const {
    return Fields::write(*this, kElement);
}

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

bool operator==(const VariationPointConfiguration__& a, const VariationPointConfiguration__& b) {
    return Fields::equal(a, b);
}

}  // namespace Configuration
