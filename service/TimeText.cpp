// Last-modified times through the date library's BDateTime.
#include "TimeText.h"

#include <stdexcept>

#include "Quorvex/BDateTime.h"

namespace ConfigurationService {
namespace {

char* digits(char* out, int value, int count) {
    for (int i = count - 1; i >= 0; --i) {
        out[i] = static_cast<char>('0' + value % 10);
        value /= 10;
    }
    return out + count;
}

}  // namespace

std::string TimeText::format(std::int64_t milliseconds) {
    char text[kLength];
    return std::string(text, format(milliseconds, text));
}

// Written digit by digit: listings format thousands of times per answer.
std::size_t TimeText::format(std::int64_t milliseconds, char* out) {
    const BDateTime time = BDateTime::fromMillisecondsSinceEpoch(milliseconds);
    if (!time.isValid()) {
        return 0;
    }
    const BDate d = time.date();
    const BTime t = time.timeOfDay();
    char* p = digits(out, d.year(), 4);
    *p++ = '-';
    p = digits(p, d.month(), 2);
    *p++ = '-';
    p = digits(p, d.day(), 2);
    *p++ = 'T';
    p = digits(p, t.hours(), 2);
    *p++ = ':';
    p = digits(p, t.minutes(), 2);
    *p++ = ':';
    p = digits(p, t.seconds(), 2);
    *p++ = '.';
    p = digits(p, t.milliseconds(), 3);
    return static_cast<std::size_t>(p - out);
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
