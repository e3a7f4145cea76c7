// The five exceptions that callers catch separately; each adds nothing but its type.
#include "Configuration/HttpConfigurationFolderLimitReachedException.h"
#include "Configuration/HttpConfigurationInvalidNodeIdException.h"
#include "Configuration/HttpConfigurationItemLimitReachedException.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/HttpConfigurationTransportException.h"

namespace Configuration {

HttpConfigurationTransportException::HttpConfigurationTransportException(const ACE_CString& message)
    : HttpConfigurationException(message) {}
HttpConfigurationTransportException::HttpConfigurationTransportException(
    const HttpConfigurationTransportException& other) = default;
HttpConfigurationTransportException& HttpConfigurationTransportException::operator=(
    const HttpConfigurationTransportException& other) = default;
HttpConfigurationTransportException::~HttpConfigurationTransportException() = default;

HttpConfigurationPathNotFoundException::HttpConfigurationPathNotFoundException(
    const ACE_CString& message)
    : HttpConfigurationException(message) {}
HttpConfigurationPathNotFoundException::HttpConfigurationPathNotFoundException(
    const HttpConfigurationPathNotFoundException& other) = default;
HttpConfigurationPathNotFoundException& HttpConfigurationPathNotFoundException::operator=(
    const HttpConfigurationPathNotFoundException& other) = default;
HttpConfigurationPathNotFoundException::~HttpConfigurationPathNotFoundException() = default;

HttpConfigurationInvalidNodeIdException::HttpConfigurationInvalidNodeIdException(
    const ACE_CString& message)
    : HttpConfigurationException(message) {}
HttpConfigurationInvalidNodeIdException::HttpConfigurationInvalidNodeIdException(
    const HttpConfigurationInvalidNodeIdException& other) = default;
HttpConfigurationInvalidNodeIdException& HttpConfigurationInvalidNodeIdException::operator=(
    const HttpConfigurationInvalidNodeIdException& other) = default;
HttpConfigurationInvalidNodeIdException::~HttpConfigurationInvalidNodeIdException() = default;

HttpConfigurationFolderLimitReachedException::HttpConfigurationFolderLimitReachedException(
    const ACE_CString& message)
    : HttpConfigurationException(message) {}
HttpConfigurationFolderLimitReachedException::HttpConfigurationFolderLimitReachedException(
    const HttpConfigurationFolderLimitReachedException& other) = default;
HttpConfigurationFolderLimitReachedException&
HttpConfigurationFolderLimitReachedException::operator=(
    const HttpConfigurationFolderLimitReachedException& other) = default;
HttpConfigurationFolderLimitReachedException::~HttpConfigurationFolderLimitReachedException() =
    default;

HttpConfigurationItemLimitReachedException::HttpConfigurationItemLimitReachedException(
    const ACE_CString& message)
    : HttpConfigurationException(message) {}
HttpConfigurationItemLimitReachedException::HttpConfigurationItemLimitReachedException(
    const HttpConfigurationItemLimitReachedException& other) = default;
HttpConfigurationItemLimitReachedException& HttpConfigurationItemLimitReachedException::operator=(
    const HttpConfigurationItemLimitReachedException& other) = default;
HttpConfigurationItemLimitReachedException::~HttpConfigurationItemLimitReachedException() = default;

}  // namespace Configuration
