#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "dpxlsx/formats/number_format_code.h"

namespace dp {

// Which section of a number-format code shows which numbers: the first whose condition holds.
// Sections without a condition share the numbers as usual: one is for all numbers; the first of two
// for those from zero on; of three, the first is for positive and the second for negative ones; the
// last is for the rest. Sections for texts do not count.
class SectionChoice {
  public:
    explicit SectionChoice(const NumberFormatCode& code);

    // How many sections are for numbers: 1 to 3, the first ones of the code.
    std::size_t count() const { return conditions_.size(); }
    // Whether the first section shows all numbers.
    bool isTrivial() const { return !conditions_.front(); }
    // The position of the section; none if no condition holds. What is not a number has the first.
    std::optional<std::size_t> of(double value) const;
    // Whether the section shows neither zero nor a positive number.
    bool isForNegativesOnly(std::size_t section) const;

  private:
    // None: all numbers that the sections before it leave.
    std::vector<std::optional<FormatCondition>> conditions_;
};

}  // namespace dp
