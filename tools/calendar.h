#pragma once

#include <string>
#include <string_view>

// Serial day numbers of the 1900 system: 1 is 1900-01-01, 60 the day 1900-02-29 that never was, 61
// is 1900-03-01; 0 stands for no day, its fraction being a time of day.
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

// Both days before 1900 that spreadsheets write for a mere time (1899-12-30, 1899-12-31) are 0.
// A month or day that no calendar has gives -1.
double serialOf(const CalendarTime& time);

// Milliseconds since 1970-01-01. The 29 February 1900 comes out as 1 March.
double unixMilliseconds(double serial);
double serialOfUnixMilliseconds(double milliseconds);

// Which fields an ICU date pattern has.
struct PatternFields {
    bool year = false;
    bool date = false;  // the year, the month, the day or the day of the week
    bool time = false;
};
PatternFields fieldsOf(std::string_view pattern);

// The serial as "2010-01-01", "18:00:00" or both with `separator` in between: what the pattern
// shows, and whatever else of the value is not zero. Milliseconds only when there are some.
// Empty for a serial that is not valid.
std::string isoText(double serial, std::string_view pattern, char separator);

}  // namespace dp::tool
