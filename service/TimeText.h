// TimeText: the text form of last-modified times in answers and requests. Times are written as
// ISO 8601 UTC with milliseconds ("2010-03-04T05:06:07.089"); requests may also carry the seven
// fraction digits and offset form. Stateless; thread-safe.
#pragma once

#include <cstdint>
#include <string>

namespace ConfigurationService {

class TimeText {
public:
    // The text of a time in milliseconds since 1970 UTC.
    static std::string format(std::int64_t milliseconds);
    // Parses a time text; throws std::invalid_argument when it is not a date and time.
    static std::int64_t parse(const std::string& text);
    // The current time in milliseconds since 1970 UTC.
    static std::int64_t now();
};

}  // namespace ConfigurationService
