#include "tools/host/calendar.h"

#include <chrono>
#include <cmath>
#include <cstdio>

namespace dp::tool {

namespace {

namespace calendar = std::chrono;

constexpr double kUnixEpoch = 25569;  // serial of 1970-01-01
constexpr long kFictitiousDay = 60;   // 1900-02-29
constexpr calendar::sys_days kDayZero{// serial n is n days later, from 1900-03-01 on
                                      calendar::year{1899} / 12 / 30};

constexpr double kNoSerial = -1;

struct DayAndTime {
    long day;
    long millisecond;
};

DayAndTime split(double serial) {
    const double total = std::floor(serial * kMillisecondsPerDay + 0.5);
    const double day = std::floor(total / kMillisecondsPerDay);
    return {static_cast<long>(day), static_cast<long>(total - day * kMillisecondsPerDay)};
}

// Converts days since 1899-12-30 to a serial day, which is one less until the end of February 1900.
double serialDay(double days) { return days > 0 && days <= kFictitiousDay ? days - 1 : days; }

std::string dateText(long day) {
    if (day == kFictitiousDay) return "1900-02-29";
    const long days = day < kFictitiousDay ? day + 1 : day;
    const calendar::year_month_day date{kDayZero + calendar::days{days}};
    char text[32];
    std::snprintf(text, sizeof text, "%04d-%02u-%02u", static_cast<int>(date.year()),
                  static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()));
    return text;
}

std::string timeText(long millisecond) {
    char text[48];
    const long second = millisecond / 1000;
    std::snprintf(text, sizeof text, "%02ld:%02ld:%02ld", second / 3600, second / 60 % 60,
                  second % 60);
    std::string result = text;
    if (millisecond % 1000 == 0) return result;
    std::snprintf(text, sizeof text, ".%03ld", millisecond % 1000);
    return result + text;
}

}  // namespace

bool isValidSerial(double serial) { return serial >= 0 && serial <= kLastSerial; }

double serialOf(const CalendarTime& time) {
    if (time.month < 1 || time.month > 12 || time.day < 1 || time.day > 31) return kNoSerial;
    const bool fictitious = time.year == 1900 && time.month == 2 && time.day == 29;
    const auto month = static_cast<unsigned>(time.month);
    const auto first =
        calendar::sys_days{calendar::year{time.year} / calendar::month{month} / calendar::day{1}};
    const double days = static_cast<double>((first - kDayZero).count() + time.day - 1);
    const double day = fictitious ? kFictitiousDay : serialDay(days);
    const double seconds = time.hour * 3600.0 + time.minute * 60.0 + time.second;
    return day + (seconds * 1000 + time.millisecond) / kMillisecondsPerDay;
}

double unixMilliseconds(double serial) {
    const double shift = serial < kFictitiousDay + 1 ? 1 : 0;
    return std::floor((serial - kUnixEpoch + shift) * kMillisecondsPerDay + 0.5);
}

double serialOfUnixMilliseconds(double milliseconds) {
    const double days = std::floor(milliseconds / kMillisecondsPerDay);
    const double rest = milliseconds - days * kMillisecondsPerDay;
    return serialDay(days + kUnixEpoch) + rest / kMillisecondsPerDay;
}

PatternFields fieldsOf(std::string_view pattern) {
    PatternFields fields;
    bool quoted = false;
    for (const char c : pattern) {
        if (c == '\'') quoted = !quoted;
        if (quoted) continue;
        const auto oneOf = [c](std::string_view letters) {
            return letters.find(c) != std::string_view::npos;
        };
        fields.year = fields.year || oneOf("yYur");
        fields.date = fields.date || oneOf("yYurMLdDEecQqwWFg");
        fields.time = fields.time || oneOf("hHkKmsSA");
    }
    return fields;
}

std::string isoText(double serial, std::string_view pattern, char separator) {
    if (!isValidSerial(serial)) return {};
    const DayAndTime value = split(serial);
    const PatternFields fields = fieldsOf(pattern);
    const bool time = fields.time || value.millisecond != 0;
    const bool date = fields.date || value.day != 0 || !time;
    if (!date) return timeText(value.millisecond);
    if (!time) return dateText(value.day);
    return dateText(value.day) + separator + timeText(value.millisecond);
}

}  // namespace dp::tool
