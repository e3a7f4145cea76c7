// OperationFailed: a request that cannot be carried out, with the HTTP status and error key that
// operations judged by HTTP status answer (legacy operations answer 200 and "ReturnStatus" 0).
// A plain exception value.
#pragma once

#include <stdexcept>
#include <string>

namespace ConfigurationService {

class OperationFailed : public std::runtime_error {
public:
    static constexpr const char* kPathNotFoundKey = "AF901DEB-1F70-41cf-879D-6EFC19168686";

    OperationFailed(const std::string& message, int status = 400,
                    const std::string& errorKey = std::string())
        : std::runtime_error(message), m_status(status), m_errorKey(errorKey) {}
    int status() const { return m_status; }
    const std::string& errorKey() const { return m_errorKey; }

    // The failure for an item that does not exist.
    static OperationFailed notFound(const std::string& host, const std::string& name) {
        return OperationFailed("configuration \"" + name + "\" of host \"" + host + "\" not found",
                               404, kPathNotFoundKey);
    }

private:
    int m_status;
    std::string m_errorKey;
};

}  // namespace ConfigurationService
