#include <cmath>
#include <cstddef>
#include <fstream>
#include <limits>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "dpxlsx/formats/date_time_translation.h"
#include "dpxlsx/formats/excel_to_icu.h"
#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/formats/section_choice.h"
#include "dpxlsx/formats/sectioned_format.h"
#include "dpxlsx/formats/standard_formats.h"
#include "dpxlsx/model/host/i_string.h"
#include "testkit/allocated_bytes.h"
#include "tests/paths.h"

namespace dp {
namespace {

std::string shown(const IVariableFormat& format, double value) {
    return std::unique_ptr<IString>(format.FormatValue(value, false))->database_str();
}

std::string shown(const std::string& code, double value) {
    return shown(*createVariableFormat(parseNumberFormat(code)), value);
}

std::string kindOf(const std::string& code) {
    switch (formatType(parseNumberFormat(code))) {
        case EXCEL_FORMAT_DATE:
            return "date";
        case EXCEL_FORMAT_TIME:
            return "time";
        case EXCEL_FORMAT_DATETIME:
            return "date-time";
        default:
            return "number";
    }
}

// Each row is what other programs show; one with a reason where that is not what is wanted.
TEST(NumberFormatCodes, ShowWhatOtherProgramsShow) {
    std::ifstream file(dataFile("number_format_codes.json"));
    const nlohmann::json table = nlohmann::json::parse(file);
    ASSERT_GT(table["codes"].size(), 400u);
    for (const auto& row : table["codes"]) {
        const std::string code = row["code"];
        SCOPED_TRACE(row.dump());
        const std::string kind = row["kind"];
        EXPECT_EQ(kindOf(code), kind);
        const auto format = createVariableFormat(parseNumberFormat(code));
        for (std::size_t i = 0; i < row["shows"].size(); ++i)
            EXPECT_EQ(shown(*format, kind == "number" ? table["number"] : table["values"][i]),
                      row["shows"][i].get<std::string>());
    }
    ASSERT_GT(table["sectioned"].size(), 90u);
    for (const auto& row : table["sectioned"]) {
        const auto format = createVariableFormat(parseNumberFormat(row["code"].get<std::string>()));
        for (std::size_t i = 0; i < table["numbers"].size(); ++i)
            EXPECT_EQ(shown(*format, table["numbers"][i]), row["shows"][i].get<std::string>())
                << row << table["numbers"][i];
    }
}

// Which section shows -1, 0, 1 and what is not a number; "-" for none.
std::string choices(const std::string& code) {
    const SectionChoice choice(parseNumberFormat(code));
    std::string text;
    for (const double value : {-1.0, 0.0, 1.0, std::numeric_limits<double>::quiet_NaN()}) {
        const auto section = choice.of(value);
        text += section ? std::to_string(*section) : "-";
    }
    return text;
}

TEST(NumberFormatCodes, SectionsByValue) {
    const char* const cases[][2] = {
        {"0", "0000"},           {"0;0", "1000"},        {"0;0;0", "1200"},    {"0;0;0;0;0", "1200"},
        {"0;@", "0000"},         {"0;0;\"x\"@", "1000"}, {"@;0", "1000"},      {"0;0;0;@", "1200"},
        {"[<0]0;0", "0110"},     {"[<=0]0;0", "0010"},   {"[=0]0;0", "1010"},  {"[<>0]0;0", "0100"},
        {"[>=0]0;0", "1000"},    {"[>0]0;0", "1100"},    {"[<0]0", "0--0"},    {"[>0]0;[<0]0", "1-00"},
        {"[<0]0;0;0", "0220"},   {"0;[=0]0;0", "2100"},  {"0;[<-1]0", "-000"}, {"[Red][>-1e0]0;0", "1000"},
        {"[=0][=1]0;0", "1100"}, {"[>]0;0", "1000"},     {"[<0x]0;0", "1000"}, {"[<-inf]0;0", "1000"},
        {"[<1e999]0;0", "1000"}, {"[=<1]0;0", "1000"},   {"0[>0]0;0", "1100"}, {"\"[<0]\"0;0", "1000"}};
    for (const auto& [code, expected] : cases) EXPECT_EQ(choices(code), expected) << code;
}

// What a host asks for is of the first section, whatever the others show.
TEST(NumberFormatCodes, SectionedFormatsForHosts) {
    const struct {
        const char* code;
        NumericSubtype subtype;
        int decimals;
        bool automatic;
    } numbers[] = {{"0.00;(0)", NumericSubtype::Fixed, 2, false},
                   {"0.0E+00;yyyy", NumericSubtype::Scientific, 1, false},
                   {"0.0%;0.00", NumericSubtype::Percentage, 1, false},
                   {"\"up\";0.00", NumericSubtype::General, 0, true}};
    for (const auto& c : numbers) {
        const auto format = createVariableFormat(parseNumberFormat(c.code));
        const auto& numeric = dynamic_cast<const INumericVariableFormat&>(*format);
        EXPECT_EQ(numeric.GetNumericSubtype(), c.subtype) << c.code;
        EXPECT_EQ(numeric.GetAuto(), c.automatic) << c.code;
        int decimals = 0;
        numeric.GetDecimalPlaces(&decimals, nullptr);
        if (const auto* percentage = dynamic_cast<const IPercentageVariableFormat*>(&numeric))
            decimals = percentage->GetDecimalPlaces();
        EXPECT_EQ(decimals, c.decimals) << c.code;
    }
    const auto dates = createVariableFormat(parseNumberFormat("yyyy-mm;[Red]\"before \"0"));
    EXPECT_STREQ(dynamic_cast<IDateTimeVariableFormat&>(*dates).GetFormatString()->database_str(), "yyyy-MM");
    EXPECT_EQ(shown(*dates, -2), "-before 2");
}

TEST(NumberFormatCodes, SectionsAndTheirTexts) {
    const struct {
        const char* code;
        double value;
        const char* expected;
    } cases[] = {{"0.0;-0.0;zero", 0, "0"},
                 {"[<100]h;yyyy-mm-dd", 45351, "2024-02-29"},
                 {"[<1]h:mm;0.0", 2.5, "2.5"},
                 {"h:mm;-h:mm", -0.25, "-6:00"},
                 {"[h]:mm;([h]:mm)", -1.5, "(36:00)"},
                 {"[h]:mm;[Red][h]:mm", -1.5, "-36:00"},
                 {"h:mm;[Red]h:mm", -0.25, "-6:00"},
                 {"h:mm;\"below \"h:mm", -0.25, "-below 6:00"},
                 {"[>1]yyyy;[h]\"x\"", -1.5, "-36x"},
                 // With the minus, for the section shows zero or some positive numbers too
                 {"[>0]0;\"~\"0", -5, "-~5"},
                 {"[>=1]0;[=0]0;\"~\"0", -5, "-~5"},
                 {"\"x\";\"x\"0", -5, "-x5"},
                 // In a section for negative numbers alone, without a minus of its own
                 {"0.0 \"kg\";0.0\"kg\"", -5, "-5.0kg"},
                 {"0;[Red]0", -5, "-5"},
                 {"$0;[$€-407]0", -5, "-€5"},
                 {"0;\"non-cash \"0", -5, "-non-cash 5"},
                 {"0;\"(\"0", -5, "-(5"},
                 {"0;\"−\"0", -5, "−5"},
                 {"0;\"a-\"0", -5, "a-5"},
                 // 5 and -5 do not look alike.
                 {"-0;+0", 5, "5"},
                 {"-0;+0", -5, "-+5"},
                 {"-0;-0", -5, "-5"},
                 {"(0);(0)", -5, "-5"},
                 {"-h;-h", -0.25, "--6"},
                 {"[<0]0;-0", 5, "5"},
                 {"[>0]0;-0", -5, "-5"},
                 {"[>9]0;(0)", 5, "5"},
                 // Units are texts of their own.
                 {"\"a\"0;-0;\"n/a\"", 0, "n/a"},
                 {"\"a\"0;-0;\"a\"", 0, "a"},
                 {"0\"d\";-0\"bad\"", -5, "-5bad"},
                 {"0\" kg\";-0\\ k\\g\\!", -5, "-5!"},
                 {"0;(000) 000-000", -5, "-5"},
                 {"0;(# ##0)", -5, "(5)"}};
    for (const auto& c : cases) EXPECT_EQ(shown(c.code, c.value), c.expected) << c.code;
}

// One letter a token: its kind, and the literals as they are.
std::string outline(const std::string& code) {
    const char* const names = "L0.,%/E*@gyMdhmsaHNS";
    std::string text;
    for (const FormatSection& section : parseNumberFormat(code).sections) {
        text += ';';
        for (const FormatToken& token : section.tokens) {
            const char name = names[static_cast<int>(token.kind)];
            text += name == 'L' ? '\'' + token.text + '\'' : std::string(1, name) + std::to_string(token.text.size());
        }
    }
    return text.substr(1);
}

TEST(NumberFormatCodes, Grammar) {
    const char* const cases[][2] = {
        {"", ""},
        {";;", ";;"},
        {";;0;;0;0", ";;01;"},
        {"0;\";\"\\;_;*;[;];@", "01;';'';'' ';@1"},
        {"\"open; y", "'open; y'"},
        {"0[$-409; y", "01"},
        {"\\", ""},
        {"d_", "d1' '"},
        {"d*", "d1"},
        {"\\年_年y*年m", "'年'' 'y1M1"},
        {"[$kr-41D][$-x][$][][q]", "'kr'"},
        {"[HhH][mM][s][hm][ h]", "H3N2S1"},
        {"xGENERAL l", "'x'*7' ''l'"},
        {"AM/PMam/pm上午/下午A/p A/M", "a5a5a13a3' ''A''/'M1"},
        {"#?0,0.0%", "03,101.101%1"},
        {"0E+0e-0 E+", "01E201E201' 'y1'+'"},
        {"# ?/8 /", "01' '01/1'8'' ''/'"},
        {"B2yb1bBB", "y1y3"},
        {"h m;m s", "h1' 'm1;m1' 's1"},
        {"hmm[$-409]\"x\":ssmmm", "h1m2'x'':'s2M3"},
    };
    for (const auto& [code, expected] : cases) EXPECT_EQ(outline(code), expected) << code;
}

TEST(NumberFormatCodes, PatternsOfTheTableAreTheSame) {
    for (const char* code : {"m/d", "d-mmm-yy", "mmmmm-yy", "dddd, mmmm dd, yyyy", "m/d/yy h:mm AM/PM", "h:mm",
                             "h:mm:ss.000", "h:mm:ss.000 AM/PM", "mm:ss.0", "mm:ss"})
        EXPECT_EQ(toIcuPattern(parseNumberFormat(code).sections[0]), *icuPatternOf(code));
    // What ICU would read as fields or quotations
    EXPECT_EQ(shown("\"a'b\"g\"c''\"yyyy\\'", 45351), "a'bc''2024'");
    EXPECT_EQ(shown("yyyy 00 General @ %/,", 45351), "2024    %/,");
    EXPECT_EQ(shown("[$EUR]yyyy.00", 45351), "EUR2024.");
    EXPECT_EQ(shown(",\"x\"0.00", 1.5), "1.50");
}

TEST(NumberFormatCodes, ElapsedTimes) {
    constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
    const struct {
        const char* code;
        double value;
        const char* expected;
    } cases[] = {{"[h]:mm:ss", -1.5, "-36:00:00"},
                 {"[h]:mm", -1e-10, "0:00"},
                 {"[hhhh]:mm \"h\"", 0.25, "0006:00 h"},
                 {"[mm]", 1e12, "1440000000000000"},
                 {"[h]:[mm]:[ss].00", 1.0625, "25:1530:91800.00"},
                 {"[h] AM/PM", 0.75, "18 PM"},
                 // Less than half a millisecond below the hour is the hour.
                 {"[h]:mm:ss", 36 / 24.0 - 4e-9, "36:00:00"},
                 {"\x01[h]'a[mm]\"b\"s", 1.0625, "25'a1530b0"},
                 {"[h]", kNaN, "nan"}};
    for (const auto& c : cases) EXPECT_EQ(shown(c.code, c.value), c.expected) << c.code << ' ' << c.value;
    // However many fields a format has, it keeps one formatter of ICU.
    std::string many;
    for (int i = 0; i < 200; ++i) many += i % 2 ? "[h]d" : "[h]m";
    const auto format = createVariableFormat(parseNumberFormat(many));
    shown(*createVariableFormat(parseNumberFormat("[h] d")), 1.5);  // what ICU keeps for all
    const std::size_t before = testkit::allocatedBytes();
    shown(*format, 1.5);
    EXPECT_LT(testkit::allocatedBytes(), before + 1'000'000);
    // Half a millisecond before the hour, counts and patterns must round alike.
    for (int hour = 1; hour < 2000; ++hour) {
        const double value = (hour * 3600000.0 - 0.5) / 86400000;
        const double minutes = std::floor(std::floor(value * 86400000 + 0.5) / 60000);
        const std::string text = shown("[h] m", value);
        EXPECT_EQ(std::stod(text) * 60 + std::stod(text.substr(text.find(' '))), minutes) << value;
    }
}

TEST(NumberFormatCodes, BuiltInFormats) {
    const struct {
        std::vector<int> ids;
        const char* shows;  // of 45351.25
    } cases[] = {{{14, 27, 31, 36, 50, 58, 71, 72}, "2/29/2024"},
                 {{15, 73}, "29-Feb-24"},
                 {{17, 75}, "Feb-24"},
                 {{18}, "6:00 AM"},
                 {{20, 76}, "6:00"},
                 {{21, 32, 35, 77}, "6:00:00"},
                 {{22, 78}, "2/29/2024 6:00"},
                 {{45, 79}, "00:00"},
                 {{46, 80}, "1088430:00:00"},
                 {{47, 81}, "00:00.0"},
                 {{0, 12, 13, 23, 26, 49, 69, 70, 82, 163, -1}, "45351.25"},
                 {{1, 3, 5, 6, 37, 38, 41, 42, 59, 61, 63}, "45351"},
                 {{2, 4, 7, 8, 39, 40, 43, 44, 60, 62, 66}, "45351.25"},
                 {{9, 67}, "4535125%"},
                 {{10, 68}, "4535125.00%"},
                 {{11}, "4.54E+04"},
                 {{48}, "4.5E+04"}};
    for (const auto& c : cases)
        for (const int id : c.ids) EXPECT_EQ(shown(std::string(builtInFormatCode(id)), 45351.25), c.shows) << id;
}

// Every text is some code, and every format of it shows something without complaint.
TEST(NumberFormatCodes, RandomCodes) {
    const std::string alphabet = "dymhsegbAaPM/[]<>=$-.0#?;\\\"_*,%E+ :'@\x80\xE5";
    std::mt19937 random(4711);
    for (int i = 0; i < 20000; ++i) {
        std::string code(random() % 24, ' ');
        for (char& c : code) c = alphabet[random() % alphabet.size()];
        const NumberFormatCode parsed = parseNumberFormat(code);
        ASSERT_FALSE(parsed.sections.empty());
        const auto format = createVariableFormat(parsed);
        ASSERT_EQ(format->GetType() == IVariableFormat::FormatType::DateTime, kindOf(code) != "number") << code;
        if (i % 10 == 0) shown(*format, i % 20 == 0 ? 45351.25 : -2);
    }
}

}  // namespace
}  // namespace dp
