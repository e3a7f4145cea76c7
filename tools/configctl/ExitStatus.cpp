#include "ExitStatus.h"

#include <stdexcept>
#include <string>

#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/HttpConfigurationTransportException.h"
#include "SiteCheck.h"
#include "Vesk/TrelException.h"

namespace Configctl {
namespace {

bool endsWith(const std::string& text, const std::string& end) {
    return text.size() >= end.size() &&
           text.compare(text.size() - end.size(), end.size(), end) == 0;
}

}  // namespace

int exitStatusFor(const std::exception& error) {
    const std::string text = error.what();
    if (dynamic_cast<const CheckFailed*>(&error) != nullptr) {
        return kExitCheckFound;
    }
    if (dynamic_cast<const Configuration::HttpConfigurationPathNotFoundException*>(&error)) {
        return kExitNotFound;
    }
    if (dynamic_cast<const Configuration::HttpConfigurationTransportException*>(&error)) {
        return kExitUnreachable;
    }
    // The service answers a missing document with its own error, whose message says so.
    const auto* answer = dynamic_cast<const Configuration::HttpConfigurationException*>(&error);
    if (answer != nullptr && endsWith(answer->Message().c_str(), " not found")) {
        return kExitNotFound;
    }
    // The service's refusal comes back as its message, through either answer form; a missing or
    // unreadable ticket is reported by the ticket module before anything is sent.
    if (text.find("access denied") != std::string::npos ||
        text.find("service ticket") != std::string::npos) {
        return kExitAccessDenied;
    }
    // A file given on the command line that cannot be read is bad input, like a bad option.
    if (dynamic_cast<const std::invalid_argument*>(&error) != nullptr ||
        dynamic_cast<const Vesk::TrelException*>(&error) != nullptr ||
        text.rfind("cannot read ", 0) == 0) {
        return kExitBadInput;
    }
    return kExitFailed;
}

}  // namespace Configctl
