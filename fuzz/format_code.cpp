// Passes number-format codes to every recogniser, and values to every format.

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/excel_to_icu.h"
#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/formats/fraction_variable_format.h"
#include "dpxlsx/formats/number_text.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/formats/sectioned_format.h"
#include "dpxlsx/formats/standard_formats.h"
#include "dpxlsx/formats/style_classification.h"
#include "dpxlsx/formats/text_variable_format.h"
#include "dpxlsx/model/host/i_string.h"
#include "fuzz/checks.h"
#include "fuzz/input.h"

namespace {

void show(const dp::IVariableFormat& format, double value) {
    for (const bool full : {false, true}) {
        const std::unique_ptr<dp::IString> text(format.FormatValue(value, full));
        fuzz::require(text != nullptr, "a value without a text");
    }
}

template <class Format>
void showAndDelete(Format* format, double value) {
    const std::unique_ptr<Format> owner(format);
    show(*owner, value);
}

void recognise(const std::string& code, double value) {
    std::string rest = code;
    if (dp::parseDecimalFormat(code)) showAndDelete(dp::createVextralDecimalFormat(rest), value);
    if (rest = code; dp::parsePercentageFormat(code))
        showAndDelete(dp::createVextralPercentageFormat(rest), value);
    if (rest = code; dp::parseScientficFormat(code))
        showAndDelete(dp::createVextralScientificFormat(rest), value);
    dp::parseCurrencyFormat(code);
    dp::EXCEL_FORMAT_TYPE type = dp::EXCEL_FORMAT_NONE;
    std::string cleaned;
    const bool dates = dp::parseDateTimeFormat(code, cleaned, type);
    fuzz::require(dates == dp::isDateTimeType(type), "a date-time code of another type");
    rest = code;
    dp::parseDateTimeFormat(rest, rest, type);
    fuzz::require(rest == cleaned, "another code when cleaned in place");
    if (const std::string* pattern = dp::icuPatternOf(cleaned))
        show(dp::DateTimeVariableFormat(*pattern), value);
    show(dp::DateTimeVariableFormat(code), value);
    dp::getRightSubString(code, static_cast<unsigned>(code.size() / 2));
}

// What reading by the standard makes of the code.
void readByStandard(const std::string& code, double value) {
    const dp::NumberFormatCode parsed = dp::parseNumberFormat(code);
    fuzz::require(!parsed.sections.empty(), "a code without a section");
    const auto format = dp::createVariableFormat(parsed);
    const bool isDateTime = format->GetType() == dp::IVariableFormat::FormatType::DateTime;
    fuzz::require(isDateTime == dp::isDateTimeType(dp::formatType(parsed)),
                  "a format of another kind");
    show(*format, value);
}

// Processes a style table as the readers do.
void styleTable(const std::string& code, double value) {
    std::vector<dp::xStyle> styles = {{"14", code, dp::EXCEL_FORMAT_NONE},
                                      {"164", code, dp::EXCEL_FORMAT_NUMBER}};
    dp::setFormatType(styles[1]);
    dp::replaceDescriptiveNames(styles, {"m/d/yy", code, "$0", "0E+0", "0.00"});
    const auto mask = [&code]() -> const std::string& { return code; };
    dp::updateFormatsForLocale(styles, {mask, mask, mask});
    for (int index = -1; index < 3; ++index)
        for (const bool dates : {false, true})
            showAndDelete(dp::createStyleFormat(styles, index, dates), value);
}

// Renders with any values of a format's fields.
void freeFormats(fuzz::Input& input, double value) {
    const auto signedByte = [&input] { return static_cast<int>(input.byte()) - 4; };
    dp::FractionVariableFormat fraction;
    fraction.denominator = input.flag() ? static_cast<int>(input.index()) : signedByte();
    fraction.fixedDenominator = input.flag();
    fraction.mixedFraction = input.flag();
    fraction.decimalPlaces = signedByte();
    fraction.significantDigits = signedByte();
    fraction.maximumDigits = signedByte();
    show(fraction, value);
    dp::NumericVariableFormat numeric;
    numeric.numericSubtype = static_cast<dp::NumericSubtype>(input.byte() % 6);
    numeric.autoFormat = input.flag();
    numeric.decimalPlaces = signedByte();
    numeric.significantDigits = signedByte();
    show(numeric, value);
    dp::PercentageVariableFormat percentage;
    percentage.percentDecimalPlaces = signedByte();
    percentage.significantDigits = signedByte();
    show(percentage, value);
    show(dp::TextVariableFormat(), value);
    dp::generalText(value, signedByte());
    std::string text = dp::scientificText(value, signedByte());
    dp::tidyScientific(text, signedByte());
    dp::useInputDecimal(text);
    fuzz::require(dp::roundTripDigits(value) <= 17, "more digits than a double has");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzz::Input input(data, size);
    fuzz::leavingNothing([&] {
        const double value = input.number();
        fuzz::Input settings(data, size);
        freeFormats(settings, value);
        const std::string code = input.rest();
        recognise(code, value);
        readByStandard(code, value);
        styleTable(code, value);
    });
    return 0;
}
