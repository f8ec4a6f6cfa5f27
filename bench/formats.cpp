// The cost of number formats.

#include <cmath>
#include <iomanip>
#include <locale>
#include <memory>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>

#include "bench/harness.h"
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/style_classification.h"
#include "dpxlsx/model/host/i_string.h"

namespace {

using Type = dp::IVariableFormat::FormatType;

constexpr char kPattern[] = "M/d/yyyy H:mm";

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

void automaticFormat(bench::Report& report) {
    const std::vector<double> values = displayedValues();
    const auto value = [&values](int i) {
        return values[static_cast<std::size_t>(i) % values.size()];
    };
    dp::NumericVariableFormat format;
    format.autoFormat = true;
    bench::addLoops(
        report, "automatic rendering / through streams, ns", {1.0 / 8},
        [&] { return bench::times(100000, [&](int i) { return renders(format, value(i)); }); },
        [&] { return bench::times(20000, [&](int i) { return streams(value(i)); }); });
}

std::unique_ptr<icu::DateFormat> icuFormatter() {
    UErrorCode status = U_ZERO_ERROR;
    auto formatter = std::make_unique<icu::SimpleDateFormat>(icu::UnicodeString::fromUTF8(kPattern),
                                                             icu::Locale::getUS(), status);
    formatter->setTimeZone(*icu::TimeZone::getGMT());
    return formatter;
}

double makeIcuFormatters() {
    return bench::times(2000, [](int) { return icuFormatter() != nullptr; });
}

void making(bench::Report& report) {
    const std::string pattern = kPattern;
    const auto ours = [&pattern](int) {
        const auto format = std::make_unique<dp::DateTimeVariableFormat>(pattern);
        return format->GetType() == Type::DateTime;
    };
    bench::addLoops(
        report, "making a date-time format / SimpleDateFormat, ns", {0.02},
        [&] { return bench::times(200000, ours); }, makeIcuFormatters);
}

void dateTimeRendering(bench::Report& report) {
    const dp::DateTimeVariableFormat format{std::string(kPattern)};
    const auto icuFormat = icuFormatter();
    icu::UnicodeString output;
    std::string utf8;
    const auto floor = [&](int i) {
        output.remove();
        utf8.clear();
        icuFormat->format((40000 + i * 0.125 - 25569) * 86400000, output);
        output.toUTF8String(utf8);
        return !utf8.empty();
    };
    bench::addLoops(
        report, "date-time rendering / ICU alone, ns", {1.3},
        [&] {
            return bench::times(20000, [&](int i) { return renders(format, 40000 + i * 0.125); });
        },
        [&] { return bench::times(20000, floor); });
}

// The cost of the format of a cell's style, including lookup and parsing.
void styleFormats(bench::Report& report) {
    std::vector<dp::xStyle> styles = {{"164", "#,##0.00", dp::EXCEL_FORMAT_NONE},
                                      {"165", "m/d/yy h:mm AM/PM", dp::EXCEL_FORMAT_DATETIME}};
    const auto ours = [&styles](int i) {
        const std::unique_ptr<dp::IVariableFormat> format(
            dp::createStyleFormat(styles, i % 2, i % 2 == 1));
        return format->GetType() == (i % 2 == 1 ? Type::DateTime : Type::Numeric);
    };
    bench::addLoops(
        report, "a style's format / SimpleDateFormat, ns", {0.02},
        [&] { return bench::times(200000, ours); }, makeIcuFormatters);
}

void measureAll(bench::Report& report) {
    for (const auto topic : {automaticFormat, making, dateTimeRendering, styleFormats})
        topic(report);
}

}  // namespace

int main(int argc, char** argv) { return bench::run(argc, argv, measureAll); }
