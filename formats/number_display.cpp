#include "dpxlsx/formats/number_display.h"

#include <cstddef>
#include <vector>

#include "dpxlsx/formats/automatic_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"

namespace dp {
namespace {

using Kind = FormatToken::Kind;

// What the tokens of a section add up to.
struct Placeholders {
    std::size_t digits = 0;
    std::size_t decimals = 0;
    int percents = 0;
    bool behindPoint = false;
    bool exponent = false;
    bool others = false;  // show something else than the digits of the number
};

// A comma between two digits groups thousands, one behind the last digit divides by a thousand.
bool divides(const std::vector<FormatToken>& tokens, std::size_t comma) {
    const bool behindDigits = comma > 0 && tokens[comma - 1].kind != Kind::Literal;
    const bool beforeDigits = comma + 1 < tokens.size() && tokens[comma + 1].kind == Kind::Digits;
    return behindDigits && !beforeDigits;
}

Placeholders placeholdersOf(const std::vector<FormatToken>& tokens) {
    Placeholders found;
    for (std::size_t i = 0; i < tokens.size(); ++i) {
        const FormatToken& token = tokens[i];
        if (token.kind == Kind::Digits && !found.exponent) {
            found.digits += token.text.size();
            if (found.behindPoint) found.decimals += token.text.size();
        }
        found.behindPoint |= token.kind == Kind::Point;
        found.exponent |= token.kind == Kind::Exponent;
        found.percents += token.kind == Kind::Percent;
        found.others |= token.kind == Kind::FractionBar || token.kind == Kind::General ||
                        token.kind == Kind::Text || isDateOrTime(token.kind) ||
                        (token.kind == Kind::Comma && divides(tokens, i));
    }
    return found;
}

std::unique_ptr<INumericVariableFormat> createNumeric(NumericSubtype subtype, int decimals) {
    auto format = std::make_unique<NumericVariableFormat>();
    format->numericSubtype = subtype;
    format->decimalPlaces = decimals;
    return format;
}

}  // namespace

NumberDisplay numberDisplay(const FormatSection& section) {
    const Placeholders found = placeholdersOf(section.tokens);
    const int decimals = static_cast<int>(found.decimals);
    if (found.digits == 0 || found.others || found.percents + found.exponent > 1) return {};
    if (found.exponent) return {NumberDisplay::Kind::Scientific, decimals};
    return {found.percents ? NumberDisplay::Kind::Percentage : NumberDisplay::Kind::Fixed,
            decimals};
}

std::unique_ptr<INumericVariableFormat> createNumberFormat(NumberDisplay display) {
    switch (display.kind) {
        case NumberDisplay::Kind::Percentage: {
            auto format = std::make_unique<PercentageVariableFormat>();
            format->percentDecimalPlaces = display.decimals;
            return format;
        }
        case NumberDisplay::Kind::Fixed:
            return createNumeric(NumericSubtype::Fixed, display.decimals);
        case NumberDisplay::Kind::Scientific:
            return createNumeric(NumericSubtype::Scientific, display.decimals);
        default:
            return createAutomaticFormat();
    }
}

}  // namespace dp
