#include "dpxlsx/formats/date_time_variable_format.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <new>

#include <unicode/datefmt.h>
#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>
#include <unicode/unistr.h>

namespace dp {
namespace {

// ICU's allocating functions report exhausted memory only by returning null.
icu::DateFormat* createICUFormatter(const std::string& pattern) {
    icu::DateFormat* formatter = nullptr;
    if (!pattern.empty()) {
        // A pattern that ICU rejects still gives a formatter, which renders as much as ICU
        // understood.
        UErrorCode status = U_ZERO_ERROR;
        formatter = new icu::SimpleDateFormat(icu::UnicodeString::fromUTF8(pattern),
                                              icu::Locale::getUS(), status);
    }
    if (!formatter)
        formatter =
            icu::DateFormat::createDateInstance(icu::DateFormat::kMedium, icu::Locale::getUS());
    if (!formatter) throw std::bad_alloc();
    formatter->setTimeZone(*icu::TimeZone::getGMT());
    return formatter;
}

// Milliseconds since 1970-01-01 00:00 UTC, rounded half up. Below serial 61 the 1900 system is one
// day behind the calendar, because it counts a 29 February 1900.
double icuMilliseconds(double serialDay) {
    const double missingLeapDay = serialDay < 61.0 ? 1.0 : 0.0;
    return std::floor((serialDay - 25569.0 + missingLeapDay) * 86400000.0 + 0.5);
}

}  // namespace

DateTimeVariableFormat::DateTimeVariableFormat() = default;

DateTimeVariableFormat::DateTimeVariableFormat(const std::string& icuPattern)
    : pattern(icuPattern) {}

DateTimeVariableFormat::~DateTimeVariableFormat() {
    delete formatter;
    formatter = nullptr;
}

IVariableFormat::FormatType DateTimeVariableFormat::GetType() const { return FormatType::DateTime; }

bool DateTimeVariableFormat::GetAuto() const { return autoFormat; }

IString* DateTimeVariableFormat::FormatValue(double value, bool) const {
    thread_local icu::UnicodeString output;
    thread_local std::string utf8;
    output.remove();
    if (!formatter) formatter = createICUFormatter(pattern.text());
    formatter->format(icuMilliseconds(value), output);
    utf8.clear();
    icu::StringByteSink<std::string> sink(&utf8);
    output.toUTF8(sink);
    return new String(utf8.c_str());  // ends at the first NUL: a pattern may contain one
}

void DateTimeVariableFormat::GetDateTimeParameters(unsigned* p1, unsigned* p2, unsigned* p3,
                                                   unsigned* p4) const {
    if (p1) *p1 = dateTimeParameters[0];
    if (p2) *p2 = dateTimeParameters[1];
    if (p3) *p3 = dateTimeParameters[2];
    if (p4) *p4 = dateTimeParameters[3];
}

void DateTimeVariableFormat::SetDateTimeParameters(const IDateTimeVariableFormat* other) {
    if (!other) return;
    unsigned values[4] = {};
    other->GetDateTimeParameters(&values[0], &values[1], &values[2], &values[3]);
    std::copy(std::begin(values), std::end(values), std::begin(dateTimeParameters));
}

const IString* DateTimeVariableFormat::GetFormatString() const { return &pattern; }

bool DateTimeVariableFormat::ConvertToDatetime(const IString*, IString*, double&) const {
    return false;
}

double DateTimeVariableFormat::GenerateTime(int, int, int, int, int, int, int) const { return 0.0; }

void DateTimeVariableFormat::SetGlobalDateTimeFormat(IString*) {}

IString* DateTimeVariableFormat::CovertVextralDateTimeToString(double) const { return nullptr; }

bool DateTimeVariableFormat::ValidVextralTime(double) const { return false; }

double DateTimeVariableFormat::GetCurrentVextralTime() const { return 0.0; }

}  // namespace dp
