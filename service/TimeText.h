// TimeText: the text form of last-modified times in answers and requests. Times are written as
// ISO 8601 UTC with milliseconds ("2010-03-04T05:06:07.089"); requests may also carry the seven
// fraction digits and offset form. Stateless; thread-safe.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace ConfigurationService {

class TimeText {
public:
    // Characters of a formatted time ("YYYY-MM-DDThh:mm:ss.fff").
    static constexpr std::size_t kLength = 23;
    // The text of a time in milliseconds since 1970 UTC; empty outside the years 0000-9999.
    static std::string format(std::int64_t milliseconds);
    // The same text written to out (room for kLength characters); returns its length.
    static std::size_t format(std::int64_t milliseconds, char* out);
    // Parses a time text; throws std::invalid_argument when it is not a date and time.
    static std::int64_t parse(const std::string& text);
    // The current time in milliseconds since 1970 UTC.
    static std::int64_t now();
};

}  // namespace ConfigurationService
