#pragma once

#include <string>
#include <string_view>

// Serial day numbers of the 1900 system: 1 is 1900-01-01, 60 is 1900-02-29, which never existed,
// and 61 is 1900-03-01. 0 stands for no day: with a fraction it is a time of day alone.
namespace dp::tool {

constexpr double kLastSerial = 2958465.99999;  // the end of the year 9999
constexpr double kMillisecondsPerDay = 86400000.0;

struct CalendarTime {
    int year;
    int month;  // 1-based
    int day;    // 1-based
    int hour;
    int minute;
    int second;
    int millisecond;
};

// True from serial 0 to the end of the year 9999.
bool isValidSerial(double serial);

// 1899-12-30 and 1899-12-31, which spreadsheets write for a time without a date, give 0. A month or
// day that does not exist gives -1.
double serialOf(const CalendarTime& time);

// Milliseconds since 1970-01-01. 29 February 1900 gives 1 March.
double unixMilliseconds(double serial);
double serialOfUnixMilliseconds(double milliseconds);

// Which fields an ICU date pattern has.
struct PatternFields {
    bool year = false;
    bool date = false;  // the year, the month, the day or the day of the week
    bool time = false;
};
PatternFields fieldsOf(std::string_view pattern);

// The serial as "2010-01-01", "18:00:00" or both with `separator` in between. Date or time is
// included if the pattern shows it or its value is not zero, milliseconds if they are not zero.
// Empty for an invalid serial.
std::string isoText(double serial, std::string_view pattern, char separator);

}  // namespace dp::tool
