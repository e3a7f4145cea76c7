// Configuration::ConfigDoc: the base of every top-level configuration class (one stored document).
//
// A document has a path in the configuration store (the registry prefix "BrimmetServer\" followed
// by the document's name), a per-machine flag, the version and lock state the store reports, and
// the time it was last stored. The derived class holds the content and reads and writes it with
// readVesk/writeVesk. Plain value owned by its caller; not thread-safe. The two static accessors
// are thread-safe and return process-wide values built on first use.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"
#include "Quorvex/BDateTime.h"
#include "Vesk/Serializable.h"

namespace Configuration {

class CONFIGURATION_API ConfigDoc : public virtual Vesk::Serializable {
public:
    ConfigDoc(const ACE_CString& path, bool isLocal);
    ConfigDoc(const ConfigDoc& other) = default;
    ConfigDoc& operator=(const ConfigDoc& other) = default;
    ~ConfigDoc() override;

    // The document's path: registry prefix followed by the document name.
    const ACE_CString& path() const { return m_path; }
    // True for a per-machine document (one copy per host).
    bool isLocal() const { return m_isLocal; }
    int version() const { return m_version; }
    void version(int version) { m_version = version; }
    int isLocked() const { return m_isLocked; }
    void isLocked(int locked) { m_isLocked = locked; }
    // When the document was last stored.
    const BDateTime& timestamp() const { return m_timestamp; }
    void timestamp(const BDateTime& timestamp) { m_timestamp = timestamp; }
    // True when other was stored strictly earlier than this document.
    bool isNewer(const ConfigDoc& other) const { return other.m_timestamp < m_timestamp; }

    // A deep copy of the whole document, derived part included (the repository's cache keeps
    // such copies without knowing the class). Derive through TypedConfigDoc to get it for free.
    virtual ConfigDoc* clone() const = 0;
    // Assigns other, which must be of the same class, to this document (derived part included);
    // std::bad_cast otherwise.
    virtual void assignFrom(const ConfigDoc& other) = 0;

    // "BrimmetServer\", the prefix of every document path.
    static const ACE_CString& getConfigurationRegistryPath();
    // This machine's short host name.
    static const ACE_CString& getLocalHostName();

private:
    ACE_CString m_path;
    bool m_isLocal;
    int m_version;
    int m_isLocked;
    BDateTime m_timestamp;
};

}  // namespace Configuration
