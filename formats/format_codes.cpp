#include "dpxlsx/formats/format_codes.h"

#include <algorithm>
#include <cstddef>
#include <memory>
#include <stdexcept>
#include <string_view>

#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"

namespace dp {

const std::string GENERAL_FORMAT = "General";
const std::string TEXT_FORMAT = "@";
const std::string SIGNIFICANT_DIGITS_MASK = "#,##0";
const std::string SCIENTIFIC_SIGNIFICANT_DIGITS_MASK = "##";
const std::string SCIENTIFIC_SHORT_FORM = "E+0";
const std::string SCIENTIFIC_LONG_FORM = "E+00";
const std::string LANG_ID_MASK = "[$";
const std::string FORMAT_TOKEN_SEPARATOR = ";";
const std::string PERCENT_SYMBOL = "%";

namespace {

constexpr int kDefaultDecimals = 2;

// "0" with an optional point behind it and zeros behind the point; also the empty text.
bool isFixedDecimal(std::string_view code) {
    // The grouping in front of a code's last integer digit changes nothing for the decimals.
    if (code.starts_with(SIGNIFICANT_DIGITS_MASK))
        code.remove_prefix(SIGNIFICANT_DIGITS_MASK.size() - 1);
    if (code.empty()) return true;
    if (code.front() != '0') return false;
    code.remove_prefix(1);
    if (code.empty()) return true;
    return code.front() == '.' && code.find_first_not_of('0', 1) == std::string_view::npos;
}

// Takes the ending `form` from the code if something stands before it.
bool removeEnding(std::string_view& code, std::string_view form) {
    if (code.size() <= form.size() || !code.ends_with(form)) return false;
    code.remove_suffix(form.size());
    return true;
}

// The count of characters behind the first point, -1 without one.
int charactersBehindPoint(std::string_view code) {
    const std::size_t point = code.find('.');
    return point == std::string_view::npos ? -1 : static_cast<int>(code.size() - point - 1);
}

int percentDecimals(std::string_view code) {
    const int behindPoint = charactersBehindPoint(code);
    if (behindPoint >= 0) return behindPoint - (code.find(PERCENT_SYMBOL) != code.npos ? 1 : 0);
    return code == "0" || code == "0%" ? 0 : kDefaultDecimals;
}

int scientificDecimals(std::string_view code) {
    const std::size_t point = code.find('.');
    if (point == std::string_view::npos) return kDefaultDecimals;
    const std::size_t mark = code.find('E', point);
    return mark == std::string_view::npos ? kDefaultDecimals : static_cast<int>(mark - point - 1);
}

NumericVariableFormat* createNumericFormat(NumericSubtype subtype, int decimalPlaces) {
    auto format = std::make_unique<NumericVariableFormat>();
    format->numericSubtype = subtype;
    format->decimalPlaces = decimalPlaces;
    return format.release();
}

}  // namespace

bool parseDecimalFormat(const std::string& code) { return isFixedDecimal(code); }

bool parsePercentageFormat(const std::string& code) {
    std::string_view body = code;
    if (!body.ends_with(PERCENT_SYMBOL)) return false;
    body.remove_suffix(PERCENT_SYMBOL.size());
    return isFixedDecimal(body);
}

bool parseScientficFormat(const std::string& code) {
    std::string_view body = code;
    if (body.starts_with(SCIENTIFIC_SIGNIFICANT_DIGITS_MASK))
        body.remove_prefix(SCIENTIFIC_SIGNIFICANT_DIGITS_MASK.size());
    const bool hasExponent =
        removeEnding(body, SCIENTIFIC_SHORT_FORM) || removeEnding(body, SCIENTIFIC_LONG_FORM);
    return hasExponent && isFixedDecimal(body);
}

bool parseCurrencyFormat(const std::string& code) {
    std::string section = code;
    removeBackslashes(section);
    section.resize(std::min(section.size(), section.find(FORMAT_TOKEN_SEPARATOR.front())));
    if (section.find(SIGNIFICANT_DIGITS_MASK) == std::string::npos) return false;
    return section.find(LANG_ID_MASK) != std::string::npos ||
           std::count(section.begin(), section.end(), '"') >= 2;
}

NumericVariableFormat* createVextralDecimalFormat(std::string& code) {
    return createNumericFormat(NumericSubtype::Fixed, std::max(0, charactersBehindPoint(code)));
}

PercentageVariableFormat* createVextralPercentageFormat(std::string& code) {
    auto format = std::make_unique<PercentageVariableFormat>();
    format->percentDecimalPlaces = percentDecimals(code);
    return format.release();
}

NumericVariableFormat* createVextralScientificFormat(std::string& code) {
    return createNumericFormat(NumericSubtype::Scientific, scientificDecimals(code));
}

std::string GetShortDateMask() { return "m/d/yy"; }

std::string getRightSubString(const std::string& text, unsigned count) {
    if (count > text.size()) throw std::out_of_range("basic_string::substr");
    return text.substr(text.size() - count);
}

void removeBackslashes(std::string& code) { std::erase(code, '\\'); }

}  // namespace dp
