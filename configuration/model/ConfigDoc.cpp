#include "Configuration/ConfigDoc.h"

#include "Quorvex/Host.h"

namespace Configuration {

ConfigDoc::ConfigDoc(const ACE_CString& path, bool isLocal)
    : m_path(path), m_isLocal(isLocal), m_version(0), m_isLocked(0) {}

ConfigDoc::~ConfigDoc() = default;

const ACE_CString& ConfigDoc::getConfigurationRegistryPath() {
    static const ACE_CString prefix("BrimmetServer\\");
    return prefix;
}

const ACE_CString& ConfigDoc::getLocalHostName() {
    static const ACE_CString name = Quorvex::GetHostName(false);
    return name;
}

}  // namespace Configuration
