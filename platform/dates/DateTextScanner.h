// DateTextScanner: a cursor over the text forms of BDate, BTime and BDateTime. It only splits
// text into numeric fields; the calendar rules (month lengths, leap years) stay with the date
// library. Every method returns false without throwing when the text does not fit. A plain value.
#pragma once

#include <cstddef>
#include <cstdint>

namespace Quorvex {
namespace DateText {

// The fields of "YYYY-MM-DD".
struct DateFields {
    int year = 0;
    int month = 0;
    int day = 0;
};

// The fields of "H...H:MM:SS[.f...]", the fraction cut to milliseconds.
struct ClockFields {
    std::int64_t hours = 0;
    int minutes = 0;
    int seconds = 0;
    int milliseconds = 0;
};

class Scanner {
public:
    Scanner(const char* text, std::size_t len) : m_p(text), m_end(text + len) {}

    // "YYYY-MM-DD" with exactly those digit counts; ranges are not checked.
    bool date(DateFields& out);
    // Hours with minHourDigits to maxHourDigits digits, then ":MM:SS" and an optional fraction
    // of one or more digits; minutes and seconds must be below 60.
    bool clock(int minHourDigits, int maxHourDigits, ClockFields& out);
    // An offset "+HH:MM" or "-HH:MM" (hours below 24, minutes below 60) as signed minutes.
    bool offset(int& minutes);
    // Consumes c if it is next.
    bool literal(char c);
    bool atEnd() const { return m_p == m_end; }

private:
    // Between minCount and maxCount decimal digits (as many as are there), as a number.
    bool digits(int minCount, int maxCount, std::int64_t& value);
    bool digits(int count, int& value);
    // The digits after a '.', the first three as milliseconds; absent fraction gives 0.
    bool fraction(int& milliseconds);

    const char* m_p;
    const char* m_end;
};

}  // namespace DateText
}  // namespace Quorvex
