// Registered services and site settings, and their line-per-record text form.
#include "Store/SiteRegistry.h"

#include <ace/OS_NS_strings.h>

#include <sstream>

#include "StoreFileName.h"

namespace Configuration {
namespace {

const char kMagic[] = "QVXREGISTRY1";

std::string encodeField(const ACE_CString& text) {
    return StoreFileName::encode(std::string(text.c_str(), text.length()));
}

bool decodeField(const std::string& encoded, ACE_CString& text) {
    std::string plain;
    if (!StoreFileName::decode(encoded, plain)) {
        return false;
    }
    text = ACE_CString(plain.data(), plain.size());
    return true;
}

bool parseService(std::istringstream& fields, SiteRegistry& registry) {
    std::string host, service, connection;
    ServiceRegistration registration;
    if (!(fields >> host >> service) || !decodeField(host, registration.host) ||
        !decodeField(service, registration.service)) {
        return false;
    }
    // An empty connection string is written as an empty field at the end of the line.
    fields >> connection;
    if (!decodeField(connection, registration.connection)) {
        return false;
    }
    registry.registerService(registration);
    return true;
}

bool parseSetting(std::istringstream& fields, SiteRegistry& registry) {
    std::string key, value, plainKey, plainValue;
    if (!(fields >> key)) {
        return false;
    }
    fields >> value;
    if (!StoreFileName::decode(key, plainKey) || !StoreFileName::decode(value, plainValue)) {
        return false;
    }
    registry.setSetting(plainKey, plainValue);
    return true;
}

}  // namespace

std::vector<ServiceRegistration>::iterator SiteRegistry::find(const ACE_CString& host,
                                                              const ACE_CString& service) {
    for (auto it = m_services.begin(); it != m_services.end(); ++it) {
        if (ACE_OS::strcasecmp(it->host.c_str(), host.c_str()) == 0 && it->service == service) {
            return it;
        }
    }
    return m_services.end();
}

void SiteRegistry::registerService(const ServiceRegistration& registration) {
    auto it = find(registration.host, registration.service);
    if (it == m_services.end()) {
        m_services.push_back(registration);
    } else {
        *it = registration;
    }
}

bool SiteRegistry::unregisterService(const ACE_CString& host, const ACE_CString& service) {
    auto it = find(host, service);
    if (it == m_services.end()) {
        return false;
    }
    m_services.erase(it);
    return true;
}

std::string SiteRegistry::serialize() const {
    std::string text = std::string(kMagic) + "\n";
    for (const ServiceRegistration& r : m_services) {
        text += "S " + encodeField(r.host) + " " + encodeField(r.service) + " " +
                encodeField(r.connection) + "\n";
    }
    for (const auto& setting : m_settings) {
        text += "V " + StoreFileName::encode(setting.first) + " " +
                StoreFileName::encode(setting.second) + "\n";
    }
    return text;
}

bool SiteRegistry::parse(const std::string& text) {
    std::istringstream lines(text);
    std::string line;
    if (!std::getline(lines, line) || line != kMagic) {
        return false;
    }
    SiteRegistry parsed;
    while (std::getline(lines, line)) {
        std::istringstream fields(line);
        std::string kind;
        fields >> kind;
        const bool ok = kind == "S"   ? parseService(fields, parsed)
                        : kind == "V" ? parseSetting(fields, parsed)
                                      : false;
        if (!ok) {
            return false;
        }
    }
    *this = parsed;
    return true;
}

}  // namespace Configuration
