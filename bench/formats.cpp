// The cost of number formats, each figure beside its floor. Prints a table; the exit code is 1 when
// a goal is missed, and 2 when a call did not do its work.

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <iomanip>
#include <limits>
#include <locale>
#include <memory>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>

#include "bench/verify.h"
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/style_classification.h"
#include "dpxlsx/model/host/i_string.h"

namespace {

using Type = dp::IVariableFormat::FormatType;

constexpr char kPattern[] = "M/d/yyyy H:mm";

// The least time of one call over several rounds, in nanoseconds. Every call returns whether it did
// its work; using the result also keeps the compiler from removing the call.
template <typename Call>
double nanoseconds(int calls, Call call) {
    double least = std::numeric_limits<double>::max();
    for (int round = 0; round < 7; ++round) {
        const auto start = std::chrono::steady_clock::now();
        int done = 0;
        for (int i = 0; i < calls; ++i) done += call(i) ? 1 : 0;
        const std::chrono::duration<double, std::nano> taken =
            std::chrono::steady_clock::now() - start;
        bench::require(done == calls, "a call did nothing");
        least = std::min(least, taken.count() / calls);
    }
    return least;
}

struct Figure {
    const char* name;
    double ours;   // nanoseconds
    double floor;  // nanoseconds
    double mostRatio;
    double mostNanoseconds = 0;  // alternatively, this time suffices
};

bool report(const Figure& figure) {
    const double ratio = figure.ours / figure.floor;
    const bool reached = ratio <= figure.mostRatio || figure.ours <= figure.mostNanoseconds;
    std::printf("%-44s %9.1f ns %9.1f ns %7.3f  <= %5.3f  %s\n", figure.name, figure.ours,
                figure.floor, ratio, figure.mostRatio, reached ? "reached" : "MISSED");
    return reached;
}

std::vector<double> displayedValues() {
    std::mt19937_64 random(1);
    std::vector<double> values;
    while (values.size() < 1000) {
        const auto integer = static_cast<double>(random() % 10000000);
        values.push_back(integer);
        values.push_back(integer / 100);
        values.push_back(integer / 7);
        values.push_back(std::ldexp(integer, -40));
    }
    return values;
}

bool streams(double value) {
    std::string text;
    double back = 0;
    for (int digits = 14; digits <= 17; ++digits) {
        std::stringstream stream;
        stream.imbue(std::locale::classic());
        stream << std::left << std::setprecision(digits) << value;
        text = stream.str();
        stream >> back;
        if (back == value) break;
    }
    const auto result = std::make_unique<std::string>(text);
    return !result->empty();
}

bool renders(const dp::IVariableFormat& format, double value) {
    const std::unique_ptr<dp::IString> text(format.FormatValue(value, false));
    return *text->database_str() != '\0';
}

bool reportAutomaticFormat() {
    const std::vector<double> values = displayedValues();
    const auto value = [&values](int i) {
        return values[static_cast<std::size_t>(i) % values.size()];
    };
    dp::NumericVariableFormat format;
    format.autoFormat = true;
    const double ours = nanoseconds(100000, [&](int i) { return renders(format, value(i)); });
    const double floor = nanoseconds(20000, [&](int i) { return streams(value(i)); });
    return report({"automatic rendering / through streams", ours, floor, 1.0 / 8});
}

std::unique_ptr<icu::DateFormat> icuFormatter() {
    UErrorCode status = U_ZERO_ERROR;
    auto formatter = std::make_unique<icu::SimpleDateFormat>(icu::UnicodeString::fromUTF8(kPattern),
                                                             icu::Locale::getUS(), status);
    formatter->setTimeZone(*icu::TimeZone::getGMT());
    return formatter;
}

bool reportMaking() {
    const std::string pattern = kPattern;
    const double ours = nanoseconds(200000, [&](int) {
        const auto format = std::make_unique<dp::DateTimeVariableFormat>(pattern);
        return format->GetType() == Type::DateTime;
    });
    const double floor = nanoseconds(2000, [](int) { return icuFormatter() != nullptr; });
    return report({"making a date-time format / SimpleDateFormat", ours, floor, 0.02, 200});
}

bool reportDateTimeRendering() {
    const dp::DateTimeVariableFormat format{std::string(kPattern)};
    const auto icuFormat = icuFormatter();
    const double ours =
        nanoseconds(20000, [&](int i) { return renders(format, 40000 + i * 0.125); });
    icu::UnicodeString output;
    std::string utf8;
    const double floor = nanoseconds(20000, [&](int i) {
        output.remove();
        utf8.clear();
        icuFormat->format((40000 + i * 0.125 - 25569) * 86400000, output);
        output.toUTF8String(utf8);
        return !utf8.empty();
    });
    return report({"date-time rendering / ICU alone", ours, floor, 1.3});
}

// The cost of the format of a cell's style, including lookup and parsing.
bool reportStyleFormats() {
    std::vector<dp::xStyle> styles = {{"164", "#,##0.00", dp::EXCEL_FORMAT_NONE},
                                      {"165", "m/d/yy h:mm AM/PM", dp::EXCEL_FORMAT_DATETIME}};
    const double ours = nanoseconds(200000, [&](int i) {
        const std::unique_ptr<dp::IVariableFormat> format(
            dp::createStyleFormat(styles, i % 2, i % 2 == 1));
        return format->GetType() == (i % 2 == 1 ? Type::DateTime : Type::Numeric);
    });
    const double floor = nanoseconds(2000, [](int) { return icuFormatter() != nullptr; });
    return report({"a style's format / SimpleDateFormat", ours, floor, 0.02, 200});
}

int reportAll() {
    std::printf("%-44s %12s %12s %7s  %8s\n", "", "ours", "floor", "ratio", "goal");
    const bool reached[] = {reportAutomaticFormat(), reportMaking(), reportDateTimeRendering(),
                            reportStyleFormats()};
    return std::all_of(std::begin(reached), std::end(reached), [](bool each) { return each; }) ? 0
                                                                                               : 1;
}

}  // namespace

int main() { return bench::resultOf(reportAll); }
