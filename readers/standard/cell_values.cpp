#include "dpxlsx/readers/standard/cell_values.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstddef>
#include <iterator>
#include <limits>
#include <string>
#include <system_error>

#include "dpxlsx/formats/digits.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"

namespace dp::standard {

namespace {

constexpr std::string_view kWhiteSpace = " \t\r\n";

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(kWhiteSpace);
    if (first == text.npos) return {};
    return text.substr(first, text.find_last_not_of(kWhiteSpace) - first + 1);
}

// What remains of a text that is being read from the left.
class Scanner {
  public:
    explicit Scanner(std::string_view text) : rest_(text) {}

    bool atEnd() const { return rest_.empty(); }
    bool take(char c) { return takeOneOf({&c, 1}); }
    bool takeOneOf(std::string_view characters) {
        if (rest_.empty() || characters.find(rest_.front()) == characters.npos) return false;
        rest_.remove_prefix(1);
        return true;
    }
    // As many digits as there are.
    std::string_view takeDigits() {
        const auto end = std::find_if_not(rest_.begin(), rest_.end(), isDigit);
        const std::string_view digits(rest_.data(), static_cast<std::size_t>(end - rest_.begin()));
        rest_.remove_prefix(digits.size());
        return digits;
    }
    // A number of exactly `count` digits.
    bool takeField(std::size_t count, int& value) {
        if (rest_.size() < count) return false;
        const char* const end = rest_.data() + count;
        if (!isDigit(rest_.front()) || std::from_chars(rest_.data(), end, value).ptr != end)
            return false;
        rest_.remove_prefix(count);
        return true;
    }

  private:
    std::string_view rest_;
};

bool isDouble(std::string_view text) {
    Scanner scanner(text);
    scanner.takeOneOf("+-");
    std::size_t digits = scanner.takeDigits().size();
    if (scanner.take('.')) digits += scanner.takeDigits().size();
    if (digits == 0) return false;
    if (!scanner.takeOneOf("eE")) return scanner.atEnd();
    scanner.takeOneOf("+-");
    return !scanner.takeDigits().empty() && scanner.atEnd();
}

bool equalWithoutCase(std::string_view text, std::string_view lowerCase) {
    return std::equal(
        text.begin(), text.end(), lowerCase.begin(), lowerCase.end(),
        [](char c, char lower) { return (c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c) == lower; });
}

// Days of the 1900 system, which counts a 29 February 1900 that was none.
std::optional<double> takeDate(Scanner& scanner) {
    int year = 0;
    int month = 0;
    int day = 0;
    if (!scanner.takeField(4, year) || !scanner.take('-') || !scanner.takeField(2, month) ||
        !scanner.take('-') || !scanner.takeField(2, day))
        return std::nullopt;
    const std::chrono::year_month_day date{std::chrono::year{year},
                                           std::chrono::month{static_cast<unsigned>(month)},
                                           std::chrono::day{static_cast<unsigned>(day)}};
    if (!date.ok()) return std::nullopt;
    constexpr int kEpoch = 25569;  // 1970-01-01
    constexpr int kAfterLeapDay = 61;
    const auto number = std::chrono::sys_days(date).time_since_epoch().count() + kEpoch;
    if (number < 0) return std::nullopt;
    // Programs write times under either day before 1900-01-01; both are day 0.
    const auto counted =
        number < kAfterLeapDay ? std::max(number - 1, decltype(number){0}) : number;
    return static_cast<double>(counted);
}

bool takeZone(Scanner& scanner) {
    int hours = 0;
    int minutes = 0;
    if (scanner.take('Z')) return true;
    if (!scanner.takeOneOf("+-")) return true;
    constexpr int kMost = 14 * 60;  // minutes, as in XML Schema
    return scanner.takeField(2, hours) && scanner.take(':') && scanner.takeField(2, minutes) &&
           minutes < 60 && hours * 60 + minutes <= kMost;
}

// The part of a day; 24:00 is its end.
std::optional<double> takeTime(Scanner& scanner) {
    int hour = 0;
    int minute = 0;
    int second = 0;
    double fraction = 0.0;
    if (!scanner.takeField(2, hour) || !scanner.take(':') || !scanner.takeField(2, minute))
        return std::nullopt;
    if (scanner.take(':')) {
        if (!scanner.takeField(2, second)) return std::nullopt;
        if (scanner.takeOneOf(".,")) {
            const std::string_view digits = scanner.takeDigits();
            if (digits.empty()) return std::nullopt;
            fraction = parseNumber("0." + std::string(digits)).value_or(0.0);
        }
    }
    if (!takeZone(scanner) || hour > 24 || minute > 59 || second > 59) return std::nullopt;
    const double seconds = hour * 3600 + minute * 60 + second + fraction;
    constexpr double kDay = 86400.0;
    if (seconds > kDay) return std::nullopt;
    return seconds / kDay;
}

// Days of a duration without years and months: "P1DT2H30M0.5S".
std::optional<double> takeDuration(Scanner& scanner) {
    struct Unit {
        char letter;
        bool ofTime;
        double perDay;
    };
    constexpr Unit kUnits[] = {
        {'D', false, 1}, {'H', true, 24}, {'M', true, 1440}, {'S', true, 86400}};
    std::optional<double> days;
    bool inTime = false;
    const Unit* unit = std::begin(kUnits);
    while (!scanner.atEnd()) {
        if (!inTime && scanner.take('T')) inTime = true;
        std::string number(scanner.takeDigits());
        if (scanner.takeOneOf(".,")) number += "." + std::string(scanner.takeDigits());
        const std::optional<double> count = parseNumber(number);
        while (unit != std::end(kUnits) && !scanner.take(unit->letter)) ++unit;
        if (!count || unit == std::end(kUnits) || unit->ofTime != inTime) return std::nullopt;
        days = days.value_or(0.0) + *count / unit->perDay;
        ++unit;
    }
    return days;
}

}  // namespace

std::optional<double> parseNumber(std::string_view text) {
    const std::string number(trimmed(text));
    if (!isDouble(number)) return std::nullopt;
    double value = 0.0;
    CmXmlCast::instance().mCast(value, number.c_str());
    return std::isfinite(value) ? std::optional(value) : std::nullopt;
}

std::optional<bool> parseBoolean(std::string_view text) {
    const std::string_view word = trimmed(text);
    const auto isOne = [word](auto... words) { return (equalWithoutCase(word, words) || ...); };
    if (isOne("1", "true", "on")) return true;
    if (isOne("0", "false", "off")) return false;
    return std::nullopt;
}

std::optional<int> parseIndex(std::string_view text) {
    const std::string_view digits = trimmed(text);
    if (digits.empty() || !std::all_of(digits.begin(), digits.end(), isDigit)) return std::nullopt;
    int index = 0;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), index);
    return result.ec == std::errc() ? index : std::numeric_limits<int>::max();
}

std::optional<IsoDateTime> parseIsoDateTime(std::string_view text) {
    const std::string_view value = trimmed(text);
    Scanner scanner(value);
    IsoDateTime result{0.0, EXCEL_FORMAT_TIME};
    if (scanner.take('P')) {
        const std::optional<double> days = takeDuration(scanner);
        return days ? std::optional(IsoDateTime{*days, EXCEL_FORMAT_TIME, true}) : std::nullopt;
    }
    if (value.find('-') == 4) {
        const std::optional<double> date = takeDate(scanner);
        if (!date) return std::nullopt;
        result = {*date, EXCEL_FORMAT_DATE};
        Scanner zone = scanner;
        if (takeZone(zone) && zone.atEnd()) return result;
        if (!scanner.takeOneOf("Tt ")) return std::nullopt;
        result.type = EXCEL_FORMAT_DATETIME;
    } else {
        scanner.takeOneOf("Tt");
    }
    const std::optional<double> time = takeTime(scanner);
    if (!time || !scanner.atEnd()) return std::nullopt;
    result.dayNumber += *time;
    return result;
}

}  // namespace dp::standard
