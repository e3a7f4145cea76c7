// Convert: conversions between the texts of the user-workflow service and the library's values
// (flags, integers, BDateTime). Static functions without state; thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"

class BDateTime;

namespace Configuration {

class CONFIGURATION_API Convert {
public:
    // "true"/"1" give true, "false"/"0" false (ignoring case); anything else throws
    // std::exception "Convert::ToBoolean: Unrecognized value".
    static bool ToBoolean(const ACE_CString& text);
    // Decimal conversion with the C library's leniency: text that is no number gives 0.
    static int ToInt(const ACE_CString& text);
    // Decimal text.
    static ACE_CString ToString(int value);
    // "true" or "false".
    static ACE_CString ToString(bool value);
    // "true" or "false", as record fields are written.
    static ACE_CString ToStringForDataSet(bool value);
    // "YYYY-MM-DDTHH:MM:SS.mmm0000-00:00": the milliseconds padded to seven fraction digits and a
    // zero offset, always; an invalid time of day is written as midnight.
    static ACE_CString ToDotNetDateTime(const BDateTime& value);
    // Parses the service's date-time text: what ToDotNetDateTime writes, ISO 8601 with up to
    // seven fraction digits and an offset or "Z", or none. Text that does not parse gives the
    // invalid BDateTime.
    static BDateTime ToBDateTime(const ACE_CString& text);

private:
    Convert() = delete;
};

}  // namespace Configuration
