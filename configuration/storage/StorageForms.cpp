#include "StorageForms.h"

namespace Configuration {
namespace StorageFields {

bool sameLinks(const ChainUtils::Chain& a, const ChainUtils::Chain& b) {
    if (a.size() != b.size()) {
        return false;
    }
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (a[i].getDefinition() != b[i].getDefinition() ||
            a[i].getDefinitionType() != b[i].getDefinitionType() ||
            a[i].getEnabled() != b[i].getEnabled()) {
            return false;
        }
    }
    return true;
}

bool sameLinks(const std::map<ACE_CString, ChainUtils::Chain>& a,
               const std::map<ACE_CString, ChainUtils::Chain>& b) {
    if (a.size() != b.size()) {
        return false;
    }
    for (auto x = a.begin(), y = b.begin(); x != a.end(); ++x, ++y) {
        if (x->first != y->first || !sameLinks(x->second, y->second)) {
            return false;
        }
    }
    return true;
}

}  // namespace StorageFields
}  // namespace Configuration
