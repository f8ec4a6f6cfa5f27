#include <cmath>
#include <cstdlib>
#include <cstring>
#include <iomanip>
#include <limits>
#include <locale>
#include <memory>
#include <random>
#include <sstream>
#include <string>
#include <type_traits>
#include <vector>

#include <gtest/gtest.h>
#include <unicode/locid.h>
#include <unicode/timezone.h>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/fraction_variable_format.h"
#include "dpxlsx/formats/number_text.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/formats/text_variable_format.h"
#include "dpxlsx/provider/excel_data_provider_base.h"
#include "testkit/allocated_bytes.h"

namespace dp {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kLargest = std::numeric_limits<double>::max();
constexpr auto kGeneral = NumericSubtype::General;
constexpr auto kFixed = NumericSubtype::Fixed;
constexpr auto kScientific = NumericSubtype::Scientific;

std::string rendered(const IVariableFormat& format, double value, bool fullPrecision = false) {
    return std::unique_ptr<IString>(format.FormatValue(value, fullPrecision))->database_str();
}

struct GroupingPunctuation : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
};

// Renders under a global locale with grouping, in another language and time zone, and restores what the tests change in
// the process.
class VariableFormats : public ::testing::Test {
  protected:
    VariableFormats() {
        UErrorCode status = U_ZERO_ERROR;
        icu::Locale::setDefault(icu::Locale::getGermany(), status);
        icu::TimeZone::adoptDefault(icu::TimeZone::createTimeZone("Asia/Tokyo"));
    }
    ~VariableFormats() override {
        UErrorCode status = U_ZERO_ERROR;
        icu::Locale::setDefault(language_, status);
        icu::TimeZone::adoptDefault(zone_.release());
        std::locale::global(previous_);
        ExcelDataProviderBase::_inputDecimal = '.';
    }

  private:
    icu::Locale language_ = icu::Locale::getDefault();
    std::unique_ptr<icu::TimeZone> zone_{icu::TimeZone::createDefault()};
    std::locale previous_ = std::locale::global({std::locale(), new GroupingPunctuation});
};

template <typename... Manipulators>
std::string streamed(double value, int precision, Manipulators... manipulators) {
    std::ostringstream stream;
    stream.imbue(std::locale::classic());
    stream << std::left << std::setprecision(precision);
    (stream << ... << manipulators) << value;
    return stream.str();
}

int streamedDigits(double value) {
    for (int digits = 14; digits < 17; ++digits) {
        std::istringstream stream(streamed(value, digits));
        stream.imbue(std::locale::classic());
        double back = 0;
        stream >> back;
        if (back == value) return digits;
    }
    return 17;
}

// A number as streams render it, step by step.
std::string streamedText(double value, NumericSubtype subtype, int decimals, bool automatic) {
    const int digits = streamedDigits(value);
    if (value == 0) value = 0;
    if (subtype != kScientific) {
        if (decimals > 0) return streamed(value, decimals, std::fixed);
        return automatic ? streamed(value, digits) : streamed(value, 0, std::fixed);
    }
    if (decimals == 0) decimals = digits - 1;
    std::string text = streamed(value, decimals, std::scientific, std::uppercase);
    std::size_t mark = text.find('E');
    if (mark == std::string::npos) return text;
    int removed = 0;
    for (; removed < decimals && text[mark - 1] == '0'; ++removed) text.erase(--mark, 1);
    if (removed == decimals) text.erase(mark - 1, 1);
    return text;
}

std::vector<double> specialValues() {
    std::vector<double> values = {0.0, -0.0,  0.1,      1.0 / 3,   kInfinity, -kInfinity, kNaN,      -kNaN,
                                  2.5, 1e308, kLargest, -kLargest, 9.9999e22, 0.5,        -12345.678};
    for (int exponent = -1074; exponent < 1024; ++exponent) {
        values.push_back(std::ldexp(exponent % 2 ? 1.0 : -1.0, exponent));
        values.push_back(std::strtod(("1e" + std::to_string(exponent / 3)).c_str(), nullptr));
    }
    return values;
}

double randomValue(std::mt19937_64& random) {
    const auto bits = random();
    const auto integer = static_cast<double>(bits >> 40);
    double value = 0;
    std::memcpy(&value, &bits, sizeof value);
    switch (random() % 4) {
        case 0:
            return integer / std::pow(10, random() % 12);
        case 1:
            return 1 / (integer + 1);
        case 2:
            return std::ldexp(integer, -1074);  // subnormal
        default:
            return value;
    }
}

TEST_F(VariableFormats, NumbersRenderAsTheClassicStreamRendersThem) {
    std::vector<double> values = specialValues();
    const std::size_t specials = values.size();
    std::mt19937_64 random(20240229);
    while (values.size() < 210000) values.push_back(randomValue(random));

    NumericVariableFormat format;
    const auto compare = [&format](double value, std::size_t variant) {
        format.autoFormat = variant == 22;
        format.numericSubtype = variant < 11 ? kFixed : format.autoFormat ? kGeneral : kScientific;
        format.decimalPlaces = static_cast<int>(variant % 11);
        ASSERT_EQ(rendered(format, value),
                  streamedText(value, format.numericSubtype, format.decimalPlaces, format.autoFormat))
            << std::hexfloat << value << ", variant " << variant;
    };
    for (std::size_t i = 0; i < values.size() && !HasFatalFailure(); ++i) {
        compare(values[i], 22);
        // Special values are rendered in all variants, the others in one each.
        for (std::size_t variant = 0; variant < 22; ++variant)
            if (i < specials || i % 22 == variant) compare(values[i], variant);
    }
    format.numericSubtype = kFixed;
    format.decimalPlaces = 1500;  // a code may have this many zeros
    for (const double value : {-1e308, 5e-324}) EXPECT_EQ(rendered(format, value), streamed(value, 1500, std::fixed));
}

TEST_F(VariableFormats, Numbers) {
    const struct {
        const char* name;
        NumericSubtype subtype;
        int decimals;
        bool automatic, full;
        double value;
        const char* expected;
        char symbol = '.';
    } cases[] = {
        {"14 digits suffice", kGeneral, 0, true, false, 0.1, "0.1"},
        {"16 digits", kGeneral, 0, true, false, 1.0 / 3, "0.3333333333333333"},
        {"15 digits exceed the largest and read as it", kGeneral, 0, true, false, kLargest, "1.79769313486232e+308"},
        {"comma", kFixed, 2, false, false, 2.5, "2,50", ','},
        {"negative decimals count as none", kFixed, -3, false, false, 2.5, "2"},
        {"full precision drops the decimals", kFixed, 2, false, true, 2.75, "3"},
        {"full precision of an automatic format", kFixed, 2, true, true, 2.75, "2.75"},
        {"all digits, comma", kScientific, 0, false, false, 123456, "1,23456E+05", ','},
        {"point goes with the zeros", kScientific, 4, false, false, 1e5, "1E+05"},
        {"full scientific", kScientific, 1, false, true, 123456, "1.23456E+05"},
        {"for a stream, -1 is 6", kScientific, -1, false, false, 1e5, "1.000000E+05"},
        {"scientific letters are upper case", kScientific, 2, false, false, -kInfinity, "-INF"}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        ExcelDataProviderBase::_inputDecimal = c.symbol;
        NumericVariableFormat format;
        format.numericSubtype = c.subtype;
        format.decimalPlaces = c.decimals;
        format.autoFormat = c.automatic;
        EXPECT_EQ(rendered(format, c.value, c.full), c.expected);
    }
    std::string text = "1.5E+005";
    tidyScientific(text, 1);
    EXPECT_EQ(text, "1.5E+05");
}

TEST_F(VariableFormats, NumbersAskTheVirtualAccessors) {
    struct : NumericVariableFormat {
        void GetDecimalPlaces(int* places, int*) const override { *places = 3; }
        bool GetAuto() const override { return true; }
        NumericSubtype GetNumericSubtype() const override { return subtype; }
        NumericSubtype subtype = kFixed;
    } format;
    EXPECT_EQ(rendered(format, 2.5) + rendered(format, 2.5, true), "2.5002.5");
    format.subtype = kScientific;
    EXPECT_EQ(rendered(format, 1234567), "1.235E+06");
}

TEST_F(VariableFormats, PercentagesAndTexts) {
    const struct {
        double value;
        int decimals, digits;
        bool full, shows;
        const char* expected;
    } cases[] = {{0.5, 0, 0, false, false, "50%"},      {0.1234, 2, 0, false, false, "12,34%"},
                 {0.1234, 2, 0, true, false, "1e+01%"}, {0.1234, 1, 4, false, true, "12,34%"},
                 {-0.0, 1, 0, false, false, "-0,0%"},   {kInfinity, 1, 0, false, false, "inf%"}};
    ExcelDataProviderBase::_inputDecimal = ',';
    for (const auto& c : cases) {
        PercentageVariableFormat format;
        format.percentDecimalPlaces = c.decimals;
        format.significantDigits = c.digits;
        format.showsFullPrecision = c.shows;
        EXPECT_EQ(rendered(format, c.value, c.full), c.expected);
    }
    EXPECT_EQ(rendered(TextVariableFormat(), 2.5), "");
}

TEST_F(VariableFormats, Fractions) {
    const struct {
        double value;
        bool mixed;
        const char* expected;
    } cases[] = {{-2.5, true, "-2 2/4"},     {2.5, false, "10/4"}, {-2.5, false, "- 10/4"},
                 {-0.25, true, "- 1/4"},     {2.99, false, "3"},   {3, false, "3"},
                 {0.125, true, "0"},         {-0.01, true, "-0"},  {-0.0, false, "0"},
                 {-kInfinity, true, "-inf"}, {kNaN, true, ""}};
    ExcelDataProviderBase::_inputDecimal = ',';  // fractions do not use it
    FractionVariableFormat format;
    EXPECT_EQ(rendered(format, 2.5), "");
    format.fixedDenominator = true;
    format.denominator = 4;
    for (const auto& c : cases) {
        format.mixedFraction = c.mixed;
        EXPECT_EQ(rendered(format, c.value), c.expected) << c.value;
    }
    format.maximumDigits = 1;
    format.significantDigits = 2;
    format.decimalPlaces = 3;
    EXPECT_EQ(rendered(format, 2.5) + rendered(format, 2.54, true), "2.0 2.00/4.0002.5");
}

TEST_F(VariableFormats, DateTimes) {
    const struct {
        const char* name;
        std::string pattern;
        double value;
        const char* expected;
    } cases[] = {{"day", "M/d/yyyy", 40179, "1/1/2010"},
                 {"day and time", "M/d/yy H:mm", 40179.75, "1/1/10 18:00"},
                 {"no pattern", "", 40179, "Jan 1, 2010"},
                 {"language", "EEEE d MMMM", 40179, "Friday 1 January"},
                 {"epoch", "yyyy-MM-dd HH:mm:ss.SSS z", 25569, "1970-01-01 00:00:00.000 GMT"},
                 {"last day before the gap", "M/d/yyyy", 59, "2/28/1900"},
                 {"late on the day that never was", "M/d/yyyy H", 60.999, "3/1/1900 23"},
                 {"the day after", "M/d/yyyy", 61, "3/1/1900"},
                 {"time only", "M/d/yyyy h:mm a", 0.5, "12/31/1899 12:00 PM"},
                 {"half a millisecond up", "H:mm:ss.SSS", 25569 + 2.5 / 86400000, "0:00:00.003"},
                 {"UTF-8", "d 'März'", 40179, "1 März"},
                 {"first NUL ends", std::string("d\0'x'", 5), 40179, "1"}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        const DateTimeVariableFormat format(c.pattern);
        EXPECT_EQ(rendered(format, c.value), c.expected);
        EXPECT_EQ(rendered(format, c.value, true), c.expected);
        EXPECT_STREQ(format.GetFormatString()->database_str(), c.pattern.c_str());
    }
    // The first value is rendered by the pattern of the constructor, whenever that is.
    static_assert(!std::is_assignable_v<decltype((std::declval<DateTimeVariableFormat&>().pattern)), String>);
    for (const char* pattern : {"", "M/d/yyyy", "'", "\xFF", "jjjj"})
        for (const double value : {kNaN, kInfinity, -kInfinity, kLargest, -kLargest, 5e-324})
            rendered(DateTimeVariableFormat(pattern), value);
}

TEST_F(VariableFormats, OneFormatterServesAFormatAndGoesWithIt) {
    const DateTimeVariableFormat kept("M/d/yyyy");
    std::size_t before = 0;
    for (int i = 0; i < 300; ++i) {
        if (i == 100) before = testkit::allocatedBytes();
        rendered(kept, i);
        rendered(DateTimeVariableFormat("M/d/yy"), i);
    }
    EXPECT_LT(testkit::allocatedBytes() - before, 100000U);
}

TEST_F(VariableFormats, DateTimeParameters) {
    DateTimeVariableFormat source, target;
    for (unsigned i = 0; i < 4; ++i) source.dateTimeParameters[i] = i + 1;
    target.SetDateTimeParameters(&source);
    target.SetDateTimeParameters(nullptr);
    unsigned p1 = 0, p2 = 0, p4 = 0;
    target.GetDateTimeParameters(&p1, &p2, nullptr, &p4);
    EXPECT_EQ(p1 * 100 + p2 * 10 + p4, 124u);
}

}  // namespace
}  // namespace dp
