// Text conversions of the user-workflow service.
#include "Configuration/Convert.h"

#include <ace/OS_NS_strings.h>

#include <cstdio>
#include <cstdlib>
#include <stdexcept>

#include "Quorvex/BDateTime.h"

namespace Configuration {

bool Convert::ToBoolean(const ACE_CString& text) {
    if (ACE_OS::strcasecmp(text.c_str(), "true") == 0 || text == "1") {
        return true;
    }
    if (ACE_OS::strcasecmp(text.c_str(), "false") == 0 || text == "0") {
        return false;
    }
    throw std::runtime_error("Convert::ToBoolean: Unrecognized value");
}

int Convert::ToInt(const ACE_CString& text) {
    return std::atoi(text.c_str());
}

ACE_CString Convert::ToString(int value) {
    char text[16];
    std::snprintf(text, sizeof text, "%d", value);
    return text;
}

ACE_CString Convert::ToString(bool value) {
    return value ? "true" : "false";
}

ACE_CString Convert::ToStringForDataSet(bool value) {
    return value ? "true" : "false";
}

ACE_CString Convert::ToDotNetDateTime(const BDateTime& value) {
    const BDate date = value.date();
    BTime time = value.timeOfDay();
    if (!value.isValid() || !time.isValid()) {
        time = BTime(0, 0, 0, 0);
    }
    char text[64];
    std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%03d0000-00:00", date.year(),
                  date.month(), date.day(), time.hours(), time.minutes(), time.seconds(),
                  time.milliseconds());
    return text;
}

BDateTime Convert::ToBDateTime(const ACE_CString& text) {
    return BDateTime(text);
}

}  // namespace Configuration
