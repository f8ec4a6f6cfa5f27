#include "tools/host/date_time_helper.h"

#include <algorithm>
#include <chrono>
#include <iterator>

#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>

#include "tools/host/calendar.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

// Tried in this order for a text in a column whose pattern is not known.
constexpr const char* kUsualPatterns[] = {
    "yyyy-MM-dd",
    "yyyy-MM-dd HH:mm",
    "yyyy-MM-dd HH:mm:ss",
    "yyyy-MM-dd HH:mm:ss.SSS",
    "yyyy-MM-dd'T'HH:mm",
    "yyyy-MM-dd'T'HH:mm:ss",
    "yyyy-MM-dd'T'HH:mm:ss.SSS",
    "M/d/yyyy",
    "M/d/yyyy H:mm",
    "M/d/yyyy H:mm:ss",
    "M/d/yyyy h:mm a",
    "M/d/yyyy h:mm:ss a",
    "d.M.yyyy",
    "d.M.yyyy H:mm",
    "d.M.yyyy H:mm:ss",
    "MMM d, yyyy",
    "d MMM yyyy",
    "d-MMM-yyyy",
    "H:mm",
    "H:mm:ss",
    "h:mm a",
    "h:mm:ss a",
};

std::unique_ptr<icu::DateFormat> makeFormatter(const std::string& pattern) {
    UErrorCode status = U_ZERO_ERROR;
    auto made = std::make_unique<icu::SimpleDateFormat>(icu::UnicodeString::fromUTF8(pattern),
                                                        icu::Locale::getUS(), status);
    if (U_FAILURE(status)) return nullptr;
    made->setTimeZone(*icu::TimeZone::getGMT());
    made->setLenient(false);
    return made;
}

}  // namespace

IString* DateTimeHelper::FormatValue(double value, bool) const {
    const std::string pattern = pattern_.database_str();
    const icu::DateFormat* format = pattern.empty() ? nullptr : formatter(pattern);
    auto text = std::make_unique<HostString>();
    if (format == nullptr) {
        *text = isoText(value, pattern, ' ');
    } else {
        icu::UnicodeString shown;
        format->format(unixMilliseconds(value), shown);
        std::string utf8;
        *text = shown.toUTF8String(utf8);
    }
    return text.release();
}

void DateTimeHelper::GetDateTimeParameters(unsigned* p1, unsigned* p2, unsigned* p3,
                                           unsigned* p4) const {
    unsigned* const targets[] = {p1, p2, p3, p4};
    for (size_t i = 0; i < std::size(targets); ++i) {
        if (targets[i] != nullptr) *targets[i] = parameters_[i];
    }
}

void DateTimeHelper::SetDateTimeParameters(const IDateTimeVariableFormat* other) {
    if (other == nullptr) return;
    other->GetDateTimeParameters(&parameters_[0], &parameters_[1], &parameters_[2],
                                 &parameters_[3]);
    const IString* pattern = other->GetFormatString();
    pattern_ = std::string(pattern == nullptr ? "" : pattern->database_str());
}

bool DateTimeHelper::ConvertToDatetime(const IString* format, IString* text, double& value) const {
    if (text == nullptr) return false;
    const std::string wanted = trimmed(text->database_str());
    const std::string pattern = format == nullptr ? "" : format->database_str();
    if (!pattern.empty()) return read(pattern, wanted, value);
    return std::any_of(std::begin(kUsualPatterns), std::end(kUsualPatterns),
                       [&](const char* usual) { return read(usual, wanted, value); });
}

double DateTimeHelper::GenerateTime(int year, int month, int day, int hour, int minute, int second,
                                    int millisecond) const {
    return serialOf({year, month, day, hour, minute, second, millisecond});
}

void DateTimeHelper::SetGlobalDateTimeFormat(IString* format) {
    pattern_ = std::string(format == nullptr ? "" : format->database_str());
}

IString* DateTimeHelper::CovertVextralDateTimeToString(double value) const {
    return FormatValue(value, true);
}

bool DateTimeHelper::ValidVextralTime(double value) const { return isValidSerial(value); }

double DateTimeHelper::GetCurrentVextralTime() const {
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    return serialOfUnixMilliseconds(std::chrono::duration<double, std::milli>(now).count());
}

const icu::DateFormat* DateTimeHelper::formatter(const std::string& pattern) const {
    auto [entry, added] = formatters_.try_emplace(pattern);
    if (added) entry->second = makeFormatter(pattern);
    return entry->second.get();
}

bool DateTimeHelper::read(const std::string& pattern, const std::string& text,
                          double& value) const {
    const icu::DateFormat* format = formatter(pattern);
    const PatternFields fields = fieldsOf(pattern);
    if (format == nullptr || text.empty() || (fields.date && !fields.year)) return false;
    const icu::UnicodeString wide = icu::UnicodeString::fromUTF8(text);
    icu::ParsePosition end(0);
    const UDate time = format->parse(wide, end);
    if (end.getErrorIndex() >= 0 || end.getIndex() != wide.length()) return false;
    const double serial = fields.date ? serialOfUnixMilliseconds(time) : time / kMillisecondsPerDay;
    if (!isValidSerial(serial)) return false;
    value = serial;
    return true;
}

}  // namespace dp::tool
