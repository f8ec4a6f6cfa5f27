#include <cstdint>
#include <memory>
#include <random>
#include <regex>
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/excel_to_icu.h"
#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/formats/style_classification.h"
#include "dpxlsx/provider/excel_data_provider_base.h"
#include "tests/case_table.h"

namespace dp {
namespace {

// Which recognisers accept the code: "D"ecimal, "P"ercentage, "S"cientific, "C"urrency.
std::string kindsOf(const std::string& code) {
    return std::string(parseDecimalFormat(code) ? "D" : "") + (parsePercentageFormat(code) ? "P" : "") +
           (parseScientficFormat(code) ? "S" : "") + (parseCurrencyFormat(code) ? "C" : "");
}

TEST(FormatCodes, NumberRecognisers) {
    const struct {
        const char* kinds;
        std::vector<const char*> codes;
    } cases[] = {{"D", {"", "0", "0.", "0.0", "0.00000000000", "#,##0", "#,##0.", "#,##0.00"}},
                 {"P", {"%", "0%", "0.%", "#,##0.0%"}},
                 {"S", {"0.00E+00", "0E+0", "##0.0E+0", "###,##0.0E+00", "#,##0E+0"}},
                 {"C", {R"("$"#,##0.00_);\("$"#,##0.00\))", "[$€-2] #,##0.00", R"(#\,##0 "days")"}},
                 {"", {"00", ".5", "0..", "0.0.0", "0.0#", "#,##", "#,##00", "#,##0_)", "General"}},
                 {"", {"0.0%%", "%0", "##E+0", "E+00", "E+0", "0.00E+000", "0.00e+00", "0.00E-00"}},
                 {"", {"#,##0.00_);(#,##0.00)", "#,##0 \"", R"("$"0.00)", R"(#,##0;"a")", R"("a";#,##0)"}}};
    for (const auto& c : cases)
        for (const char* code : c.codes) EXPECT_EQ(kindsOf(code), c.kinds) << code;
}

// The type and the cleaned code; 0 for a code that is rejected.
std::string dateTimeParse(const std::string& code) {
    std::string cleaned = "before";
    EXCEL_FORMAT_TYPE type = EXCEL_FORMAT_NONE;
    const bool accepted = parseDateTimeFormat(code, cleaned, type);
    EXPECT_EQ(accepted, type != EXCEL_FORMAT_NONE) << code;
    return std::to_string(type) + ' ' + cleaned;
}

TEST(FormatCodes, DateTimeCodes) {
    ExcelDataProviderBase::_inputDecimal = ',';
    const struct {
        const char* type;
        std::vector<std::string> codes;  // which must not change
    } groups[] = {{"0 ", {"", "General", "DD/MM/YYYY", "qq QQ Q", "WW wk W", "0.00"}},
                  {"7 ", {"m", "mmm", "[$-409 d", "Qq", "qQ0", "Wk", "Ww", "[Red]0.0"}},
                  {"8 ", {"mm:ss", "h:mm", "hm:m0s", "mm:ss.0", "ss.00["}},
                  {"9 ", {"mmm:ss", "h:mmm", "h:m:mm", "mh", "m/d/yy h:mm", "0 \"sad\"", "d [ss.0"}}};
    for (const auto& group : groups)
        for (const std::string& code : group.codes) EXPECT_EQ(dateTimeParse(code), group.type + code);

    const char* const changed[][2] = {{"[$-409]h:mm:ss AM/PM;@", "8 h:mm:ss AM/PM"},
                                      {"\\[$-409]mmm\\-yy", "7 mmm-yy"},
                                      {"yyyy [$-409]0", "0 0"},
                                      {"d]h[$x]0;y", "0 0;y"},
                                      {"\\0.00;\\d", "0 0.00;d"},
                                      {"[h]:mm:ss.000", "8 [h]:mm:ss,sss"},
                                      {"[s].00000", "8 [s],sss00"},
                                      {"[s.0x0.00", "8 [s,sx0,ss"},
                                      {"[s.:mm.0", "9 [s,:mm.0"}};
    for (const auto& [code, expected] : changed) EXPECT_EQ(dateTimeParse(code), expected) << code;
    ExcelDataProviderBase::_inputDecimal = '.';
    EXPECT_EQ(dateTimeParse("[h]:mm:ss.000"), "8 [h]:mm:ss.sss");
}

TEST(FormatCodes, RandomCodes) {
    const std::string alphabet = "dymhsQqWkw[]$.0;\\\"#,%E+- :/@";
    std::mt19937 random(4711);
    for (int i = 0; i < 100000; ++i) {
        std::string code(random() % 24, ' '), plain;
        for (char& c : code) {
            c = alphabet[random() % alphabet.size()];
            if (c != '\\') plain += c;
        }
        SCOPED_TRACE(code);
        const std::size_t tag = plain.find("[$"), end = plain.find(']', tag);
        if (tag != plain.npos && end != plain.npos) plain = plain.substr(end + 1);
        const std::string section = plain.substr(0, plain.find(';'));
        std::string cleaned = code;
        EXCEL_FORMAT_TYPE type = EXCEL_FORMAT_PERCENT;
        if (parseDateTimeFormat(code, cleaned, type)) {
            ASSERT_TRUE(type == 7 || type == 8 || type == 9);
            ASSERT_EQ(cleaned.size(), section.size());
            ASSERT_NE(section.find_first_of("dymhsQqW"), std::string::npos);
        } else {
            ASSERT_EQ(type, EXCEL_FORMAT_PERCENT);
            ASSERT_EQ(cleaned, plain);
            ASSERT_EQ(section.find_first_of("dymhs"), std::string::npos);
        }
        ASSERT_LE(kindsOf(code).size(), 1u);
    }
}

// The pattern, derived from the meaning of the letters: "m" is a month except after hours or before seconds.
std::string expectedPattern(std::string code) {
    const char* const hours = code.find("AM/PM") != std::string::npos ? "h:mm" : "H:mm";
    const char* const steps[][2] = {{"AM/PM", "a"},   {"m", "M"},          {"h:MM", hours},
                                    {"dddd", "EEEE"}, {"^MM:ss", "mm:ss"}, {"0", "S"}};
    for (const auto& [from, to] : steps) code = std::regex_replace(code, std::regex(from), to);
    return code;
}

TEST(FormatCodes, IcuPatterns) {
    for (const char* code :
         {"m/d",           "d/m",          "m/d/yy",           "mm/dd/yy",          "d/m/yy",
          "dd/mm/yy",      "d-mmm",        "d-mmm-yy",         "dd-mmm-yy",         "mmm-yy",
          "mmmm-yy",       "mmmm d, yyyy", "m/d/yy h:mm",      "m/d/yy h:mm AM/PM", "mmmmm",
          "mmmmm-yy",      "m/d/yyyy",     "d/m/yyyy",         "d-mmm-yyyy",        "dddd, mmmm dd, yyyy",
          "h:mm",          "h:mm AM/PM",   "h:mm:ss",          "h:mm:ss.000",       "mm:ss",
          "h:mm:ss AM/PM", "mm:ss.0",      "h:mm:ss.000 AM/PM"}) {
        ASSERT_NE(icuPatternOf(code), nullptr) << code;
        EXPECT_EQ(*icuPatternOf(code), expectedPattern(code));
    }
    for (const char* code : {"", "yyyy", "M/D", "m/d ", "m/d/yy hh:mm", "hh:mm"})
        EXPECT_EQ(icuPatternOf(code), nullptr) << code;
}

TEST(FormatCodes, RightSubString) {
    EXPECT_EQ(getRightSubString("mm/yy", 2), "yy");
    EXPECT_EQ(getRightSubString("mm", 2), "mm");
    EXPECT_THROW(getRightSubString("mm", 3), std::out_of_range);
}

// Kind, automatic flag and decimal places of a number format; the pattern of a date-time format.
std::string inWords(const IVariableFormat& format) {
    if (const auto* dateTime = dynamic_cast<const DateTimeVariableFormat*>(&format))
        return dateTime->GetFormatString()->database_str();
    if (const auto* percentage = dynamic_cast<const PercentageVariableFormat*>(&format))
        return "percentage " + std::to_string(percentage->percentDecimalPlaces);
    const auto& numeric = dynamic_cast<const NumericVariableFormat&>(format);
    const char* const kinds[] = {"general ", "fixed ", "scientific "};
    return (numeric.autoFormat ? "automatic " : "") + std::string(kinds[static_cast<int>(numeric.numericSubtype)]) +
           std::to_string(numeric.decimalPlaces);
}

std::string formatOf(std::vector<xStyle>& styles, int index, bool isDateTime) {
    return inWords(*std::unique_ptr<IVariableFormat>(createStyleFormat(styles, index, isDateTime)));
}

TEST(StyleClassification, CodesFromTheFile) {
    for (const auto& c : caseTable("format_codes.txt")) {
        SCOPED_TRACE(c[0]);
        std::vector<xStyle> styles = {{"164", c[1], EXCEL_FORMAT_PARENTHESES}};
        setFormatType(styles[0]);
        EXPECT_EQ(std::to_string(styles[0].formatType), c[2]);
        EXPECT_EQ(styles[0].formatCode, c[3]);
        EXPECT_EQ(formatOf(styles, 0, c[2] != "0"), c[4]);
    }
}

TEST(StyleClassification, FormatsOfTheTable) {
    std::vector<xStyle> styles = {{"14", "m\\/d\\", 7}, {"9", "mmm-yy", 0}};
    EXPECT_EQ(formatOf(styles, 0, true), "M/d");
    EXPECT_EQ(styles[0].formatCode, "m/d");
    EXPECT_EQ(formatOf(styles, 1, false), "automatic general 0");
    for (const int outside : {-1, 2, INT32_MIN, INT32_MAX})
        EXPECT_EQ(formatOf(styles, outside, true), "automatic general 0");
    for (int type = -1; type < 12; ++type)
        EXPECT_EQ(isDateTimeType(EXCEL_FORMAT_TYPE(type)), type == 7 || type == 8 || type == 9);
}

TEST(StyleClassification, DescriptiveNames) {
    for (const auto& c : caseTable("descriptive_names.txt")) {
        std::vector<xStyle> styles = {{"", "other", 10}, {"", c[1], 10}};
        replaceDescriptiveNames(styles, {"m/d/yy", "0.00%", "$0", "0.00E+00", "0.00"});
        EXPECT_EQ(styles[0].formatCode, "other");
        EXPECT_EQ(styles[1].formatCode, c[2]);
        EXPECT_EQ(std::to_string(styles[1].formatType), c[3]) << c[1];
    }
}

}  // namespace
}  // namespace dp
