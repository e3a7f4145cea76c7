// Last-modified times through the date library's BDateTime.
#include "TimeText.h"

#include <stdexcept>

#include "Quorvex/BDateTime.h"

namespace ConfigurationService {

std::string TimeText::format(std::int64_t milliseconds) {
    return BDateTime::fromMillisecondsSinceEpoch(milliseconds).ToString().c_str();
}

std::int64_t TimeText::parse(const std::string& text) {
    const BDateTime time(ACE_CString(text.c_str()));
    if (!time.isValid()) {
        throw std::invalid_argument("LastModifiedTime \"" + text + "\" is not a date and time");
    }
    return time.millisecondsSinceEpoch();
}

std::int64_t TimeText::now() {
    return BDateTime::Now().millisecondsSinceEpoch();
}

}  // namespace ConfigurationService
