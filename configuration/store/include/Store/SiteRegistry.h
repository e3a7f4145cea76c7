// SiteRegistry: the services that hosts registered with the configuration service, and a few
// named site settings, with their text form for the store directory (one record per line, every
// field percent-encoded). Plain data owned by DirectoryStore, which guards it; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <map>
#include <string>
#include <vector>

namespace Configuration {

// One registered service of one host.
struct ServiceRegistration {
    ACE_CString host;
    ACE_CString service;
    ACE_CString connection;
};

class SiteRegistry {
public:
    static constexpr const char* kFileName = "___registry___";

    // Adds or replaces the registration of (host, service); hosts compare without case.
    void registerService(const ServiceRegistration& registration);
    // Removes (host, service); false when it was not registered.
    bool unregisterService(const ACE_CString& host, const ACE_CString& service);
    // Every registration, in the order they were first made.
    const std::vector<ServiceRegistration>& services() const { return m_services; }

    // Sets a named setting.
    void setSetting(const std::string& key, const std::string& value) { m_settings[key] = value; }
    // All settings by name.
    const std::map<std::string, std::string>& settings() const { return m_settings; }

    // The text form.
    std::string serialize() const;
    // Replaces the contents from the text form; false (contents unchanged) when malformed.
    bool parse(const std::string& text);

private:
    std::vector<ServiceRegistration>::iterator find(const ACE_CString& host,
                                                    const ACE_CString& service);

    std::vector<ServiceRegistration> m_services;
    std::map<std::string, std::string> m_settings;
};

}  // namespace Configuration
