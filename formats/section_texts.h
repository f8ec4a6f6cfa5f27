#pragma once

#include <cstddef>
#include <string>

#include "dpxlsx/formats/number_format_code.h"

namespace dp {

// The literals around what a section shows of a value, without the spaces at their outer ends.
struct SectionTexts {
    std::string before;
    std::string behind;

    bool empty() const { return before.empty() && behind.empty(); }
};

// Whether the section consists of nothing but literals.
bool isTextAlone(const FormatSection& section);

// Whether literals other than spaces stand among the digits: "(000) 000-0000".
bool hasTextWithin(const FormatSection& section);

// Whether the texts say that the number between them is negative: by parentheses around it or by a
// minus sign, which is not the hyphen of a word.
bool showMinus(const SectionTexts& texts);

// The texts of the section `position`; of one of nothing but literals, all are before. Texts around
// the values of the first section are units ("0.0 kg") and removed from those around the values of
// the others, but never from within a text.
SectionTexts textsOf(const NumberFormatCode& code, std::size_t position);

}  // namespace dp
