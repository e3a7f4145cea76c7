// HttpConfigurationException: the error of every remote configuration access. Carries the
// service's error record (message, key, code, localized message, server stack trace); what() is
// built once at construction and never contains the localized message. A plain value: copies are
// independent, and a const object may be read from any thread.
#pragma once

#include <ace/SString.h>

#include <exception>

#include "Configuration/Export.h"

namespace Configuration {

class CONFIGURATION_API HttpConfigurationException : public std::exception {
public:
    // A message only; every other field empty.
    explicit HttpConfigurationException(const ACE_CString& message);
    // An error key and a message.
    HttpConfigurationException(const ACE_CString& key, const ACE_CString& message);
    // Key, message, server stack trace and localized message; the code stays empty.
    HttpConfigurationException(const ACE_CString& key, const ACE_CString& message,
                               const ACE_CString& originalStackTrace,
                               const ACE_CString& localizedMessage);
    // Every field.
    HttpConfigurationException(const ACE_CString& key, const ACE_CString& code,
                               const ACE_CString& message, const ACE_CString& originalStackTrace,
                               const ACE_CString& localizedMessage);
    HttpConfigurationException(const HttpConfigurationException& other);
    HttpConfigurationException& operator=(const HttpConfigurationException& other);
    ~HttpConfigurationException() override;

    // "HttpConfigurationException: " + message, then key, code and stack trace when present.
    const char* what() const noexcept override;

    // The human-readable message.
    ACE_CString Message() const { return m_message; }
    // The service's error key (a GUID text), may be empty.
    ACE_CString Key() const { return m_key; }
    // The service's numeric error code as text, may be empty.
    ACE_CString Code() const { return m_code; }
    // The message in the user's language, in the local code page.
    ACE_CString LocalizedMessage() const { return m_localizedMessage; }
    // The stack trace reported by the server, may be empty.
    ACE_CString OriginalStackTrace() const { return m_originalStackTrace; }

private:
    void Initialize();

    ACE_CString m_message;
    ACE_CString m_key;
    ACE_CString m_code;
    ACE_CString m_localizedMessage;
    ACE_CString m_originalStackTrace;
    ACE_CString m_what;
};

}  // namespace Configuration
