#include "Configuration/HttpConfigurationException.h"

namespace Configuration {

HttpConfigurationException::HttpConfigurationException(const ACE_CString& message)
    : m_message(message) {
    Initialize();
}

HttpConfigurationException::HttpConfigurationException(const ACE_CString& key,
                                                       const ACE_CString& message)
    : m_message(message), m_key(key) {
    Initialize();
}

HttpConfigurationException::HttpConfigurationException(const ACE_CString& key,
                                                       const ACE_CString& message,
                                                       const ACE_CString& originalStackTrace,
                                                       const ACE_CString& localizedMessage)
    : m_message(message),
      m_key(key),
      m_localizedMessage(localizedMessage),
      m_originalStackTrace(originalStackTrace) {
    Initialize();
}

HttpConfigurationException::HttpConfigurationException(const ACE_CString& key,
                                                       const ACE_CString& code,
                                                       const ACE_CString& message,
                                                       const ACE_CString& originalStackTrace,
                                                       const ACE_CString& localizedMessage)
    : m_message(message),
      m_key(key),
      m_code(code),
      m_localizedMessage(localizedMessage),
      m_originalStackTrace(originalStackTrace) {
    Initialize();
}

HttpConfigurationException::HttpConfigurationException(const HttpConfigurationException& other) =
    default;

HttpConfigurationException& HttpConfigurationException::operator=(
    const HttpConfigurationException& other) = default;

HttpConfigurationException::~HttpConfigurationException() = default;

const char* HttpConfigurationException::what() const noexcept {
    return m_what.c_str();
}

// The localized message stays out of what(): it is meant for the user, not for logs.
void HttpConfigurationException::Initialize() {
    m_what = "HttpConfigurationException: ";
    m_what += m_message;
    if (!m_key.empty()) {
        m_what += " ErrorKey: ";
        m_what += m_key;
    }
    if (!m_code.empty()) {
        m_what += " ErrorCode: ";
        m_what += m_code;
    }
    if (!m_originalStackTrace.empty()) {
        m_what += " OriginalStackTrace: ";
        m_what += m_originalStackTrace;
    }
}

}  // namespace Configuration
