#include "dpxlsx/formats/sectioned_format.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "dpxlsx/formats/automatic_format.h"
#include "dpxlsx/formats/beyond_pattern.h"
#include "dpxlsx/formats/date_time_translation.h"
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/number_display.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/formats/section_choice.h"
#include "dpxlsx/formats/section_texts.h"
#include "dpxlsx/model/string.h"

namespace dp {
namespace {

enum class Sign {
    OfFormat,
    BeforeTexts,
    None,  // the texts are in place of it
};

// How a section shows values.
struct Display {
    std::unique_ptr<IVariableFormat> format;  // null if the text is in place of the number
    Sign sign = Sign::OfFormat;
    SectionTexts texts = {};
    bool zeroHasDigits = true;
    bool textsAreForZero = false;  // they would give other numbers a wrong sign
};

bool isDateTime(const FormatSection& section) { return dateTimeType(section) != EXCEL_FORMAT_NONE; }

std::unique_ptr<IVariableFormat> createFormat(const FormatSection& section) {
    if (isDateTime(section)) return createDateTimeFormat(section);
    return createNumberFormat(numberDisplay(section));
}

std::string shown(const IVariableFormat& format, double value, bool fullPrecision) {
    const std::unique_ptr<IString> text(format.FormatValue(value, fullPrecision));
    return text->database_str();
}

std::string shown(const Display& display, double value, bool fullPrecision) {
    const auto& [format, sign, texts, zeroHasDigits, textsAreForZero] = display;
    if (textsAreForZero && value != 0) return shown(*format, value, fullPrecision);
    std::string text = sign == Sign::BeforeTexts && value < 0 ? "-" : "";
    text += texts.before;
    if (format && (value != 0 || zeroHasDigits))
        text += shown(*format, sign == Sign::OfFormat ? value : std::fabs(value), fullPrecision);
    return text + texts.behind;
}

// Whether the numeric formats show the number in the way that the texts around it are meant for.
bool isShownAsMeant(const FormatSection& section) {
    if (hasTextWithin(section)) return false;
    return numberDisplay(section).kind != NumberDisplay::Kind::Automatic ||
           std::any_of(section.tokens.begin(), section.tokens.end(), [](const FormatToken& token) {
               return token.kind == FormatToken::Kind::General;
           });
}

bool hasZeroDigit(const FormatSection& section) {
    return std::any_of(section.tokens.begin(), section.tokens.end(), [](const FormatToken& token) {
        return token.kind == FormatToken::Kind::General ||
               (token.kind == FormatToken::Kind::Digits && token.text.find('0') != token.text.npos);
    });
}

class SectionedDisplay {
  public:
    explicit SectionedDisplay(const NumberFormatCode& code)
        : choice_(code), rest_(createAutomaticFormat()) {
        for (std::size_t i = 0; i < choice_.count(); ++i) displays_.push_back(displayOf(code, i));
    }

    std::string text(double value, bool fullPrecision) const {
        const std::optional<std::size_t> section = choice_.of(value);
        if (!section) return shown(*rest_, value, fullPrecision);
        return shown(displays_[*section], value, fullPrecision);
    }

  private:
    Display displayOf(const NumberFormatCode& code, std::size_t position) const {
        const FormatSection& section = code.sections[position];
        SectionTexts texts = textsOf(code, position);
        if (isTextAlone(section) && !texts.empty()) return {nullptr, Sign::None, std::move(texts)};
        // Date letters among numbers are those of a word that lacks its quotes: "0;-0;zero".
        if (isDateTime(section) && !isDateTime(code.sections.front()))
            return {createAutomaticFormat()};
        Display display{createFormat(section)};
        if (position == 0) return display;
        const bool isForNegatives = choice_.isForNegativesOnly(position);
        const bool hasMinus = showMinus(texts);
        const Sign sign = isForNegatives && hasMinus ? Sign::None : Sign::BeforeTexts;
        if (isDateTime(section)) {  // its format shows the texts
            if (isForNegatives) display.sign = sign;
        } else if (!texts.empty() && isShownAsMeant(section)) {
            display.sign = sign;
            display.texts = std::move(texts);
            display.zeroHasDigits = hasZeroDigit(section);
            display.textsAreForZero = hasMinus && !isForNegatives;
        }
        return display;
    }

    SectionChoice choice_;
    std::vector<Display> displays_;
    std::unique_ptr<IVariableFormat> rest_;  // for numbers that no section is for
};

// A format of the class `Base`, for hosts, that renders by sections.
template <class Base>
class SectionedFormat final : public Base, public BeyondPattern {
  public:
    template <class Like>
    SectionedFormat(const Like& first, const NumberFormatCode& code)
        : Base(first), display_(code) {}

    IString* FormatValue(double value, bool fullPrecision) const override {
        return new String(display_.text(value, fullPrecision));
    }

  private:
    SectionedDisplay display_;
};

}  // namespace

std::unique_ptr<IVariableFormat> createVariableFormat(const NumberFormatCode& code) {
    const FormatSection& first = code.sections.front();
    if (SectionChoice(code).isTrivial()) return createFormat(first);
    if (isDateTime(first))
        return std::make_unique<SectionedFormat<DateTimeVariableFormat>>(toIcuPattern(first), code);
    const std::unique_ptr<INumericVariableFormat> like = createNumberFormat(numberDisplay(first));
    if (like->GetNumericSubtype() == NumericSubtype::Percentage)
        return std::make_unique<SectionedFormat<PercentageVariableFormat>>(
            static_cast<const PercentageVariableFormat&>(*like), code);
    return std::make_unique<SectionedFormat<NumericVariableFormat>>(
        static_cast<const NumericVariableFormat&>(*like), code);
}

}  // namespace dp
