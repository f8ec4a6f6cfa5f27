#include "dpxlsx/formats/style_classification.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <utility>

#include "dpxlsx/formats/automatic_format.h"
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/excel_to_icu.h"
#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/formats/percentage_variable_format.h"

namespace dp {
namespace {

struct DescriptiveName {
    std::string_view name;
    std::string_view code;
    EXCEL_FORMAT_TYPE type;
};

struct LocaleStyle {
    const char* styleId;
    unsigned flags;
};

// In the order of their ids.
constexpr LocaleStyle kLocaleStyles[] = {
    {"14", DATE_PART},
    {"18", TIME_PART | AMPM_PART},
    {"19", TIME_PART | SECONDS_PART | AMPM_PART},
    {"20", TIME_PART},
    {"21", TIME_PART | SECONDS_PART},
    {"22", DATE_PART | TIME_PART},
};

IVariableFormat* makeDateTimeFormat(std::string& code) {
    removeBackslashes(code);
    const std::string* pattern = icuPatternOf(code);
    return pattern ? new DateTimeVariableFormat(*pattern) : new DateTimeVariableFormat();
}

IVariableFormat* makeNumberFormat(std::string& code) {
    if (parseDecimalFormat(code)) return createVextralDecimalFormat(code);
    if (parsePercentageFormat(code)) return createVextralPercentageFormat(code);
    if (parseCurrencyFormat(code)) return createAutomaticFormat().release();
    if (parseScientficFormat(code)) return createVextralScientificFormat(code);
    return createAutomaticFormat().release();
}

}  // namespace

bool isDateTimeType(EXCEL_FORMAT_TYPE type) noexcept {
    return type >= EXCEL_FORMAT_DATE && type <= EXCEL_FORMAT_DATETIME;
}

void setFormatType(xStyle& style) {
    style.formatType = EXCEL_FORMAT_NONE;
    if (parseScientficFormat(style.formatCode) || parsePercentageFormat(style.formatCode) ||
        parseCurrencyFormat(style.formatCode))
        return;  // letters in its quoted texts are not date letters

    std::string cleaned;
    EXCEL_FORMAT_TYPE type = EXCEL_FORMAT_NONE;
    if (!parseDateTimeFormat(style.formatCode, cleaned, type)) return;
    style.formatCode = std::move(cleaned);
    style.formatType = type;
}

void replaceDescriptiveNames(std::vector<xStyle>& styles, const NamedFormats& formats) {
    const DescriptiveName names[] = {
        {"General Date", "m/d/yyyy h:mm", EXCEL_FORMAT_DATETIME},
        {"Long Date", "d-mmm-yy", EXCEL_FORMAT_DATE},
        {"Medium Date", "d-mmm-yy", EXCEL_FORMAT_DATE},
        {"Short Date", formats.shortDate, EXCEL_FORMAT_DATE},
        {"Long Time", "h:mm:ss AM/PM", EXCEL_FORMAT_TIME},
        {"Medium Time", "h:mm AM/PM", EXCEL_FORMAT_TIME},
        {"Short Time", "h:mm", EXCEL_FORMAT_TIME},
        {"Percent", formats.percent, EXCEL_FORMAT_PERCENT},
        {"Currency", formats.currency, EXCEL_FORMAT_CURRENCY},
        {"Scientific", formats.scientific, EXCEL_FORMAT_SCIENTIFIC},
        {"Fixed", formats.fixed, EXCEL_FORMAT_NUMBER},
    };
    for (xStyle& style : styles) {
        const auto found = std::find_if(
            std::begin(names), std::end(names),
            [&style](const DescriptiveName& entry) { return entry.name == style.formatCode; });
        if (found == std::end(names)) continue;
        style.formatCode = found->code;
        style.formatType = found->type;
    }
}

void composeDateTimeCode(std::string& code, unsigned flags, const DateTimeMasks& masks) {
    std::string time = masks.time();
    if (!(flags & TIME_PART)) {
        if (flags & DATE_PART) code = GetShortDateMask();
        return;
    }
    if (flags & SECONDS_PART) time += masks.separator() + "ss";
    if (flags & AMPM_PART) time += " " + masks.ampm();
    code = flags & DATE_PART ? GetShortDateMask() + " " + time : std::move(time);
}

void updateFormatsForLocale(std::vector<xStyle>& styles, const DateTimeMasks& masks) {
    for (const LocaleStyle& entry : kLocaleStyles) {
        const auto style =
            std::find_if(styles.begin(), styles.end(), DateTimeFormatEqualCode(entry.styleId));
        if (style != styles.end()) composeDateTimeCode(style->formatCode, entry.flags, masks);
    }
}

DateTimeFormatEqualCode::DateTimeFormatEqualCode(std::string styleId)
    : styleId_(std::move(styleId)) {}

bool DateTimeFormatEqualCode::operator()(const xStyle& style) const {
    return style.styleId == styleId_;
}

IVariableFormat* createStyleFormat(std::vector<xStyle>& styles, int styleIndex, bool isDateTime) {
    if (styleIndex < 0 || static_cast<std::size_t>(styleIndex) >= styles.size())
        return createAutomaticFormat().release();
    std::string& code = styles[static_cast<std::size_t>(styleIndex)].formatCode;
    return isDateTime ? makeDateTimeFormat(code) : makeNumberFormat(code);
}

}  // namespace dp
