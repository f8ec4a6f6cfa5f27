#include "dpxlsx/formats/section_choice.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace dp {
namespace {

using Comparison = FormatCondition::Comparison;

bool showsText(const FormatSection& section) {
    return std::any_of(section.tokens.begin(), section.tokens.end(), [](const FormatToken& token) {
        return token.kind == FormatToken::Kind::Text;
    });
}

// The fourth section is for texts, and so is the last of fewer when it shows the cell's text.
std::size_t countForNumbers(const std::vector<FormatSection>& sections) {
    constexpr std::size_t kMost = 3;
    if (sections.size() > kMost) return kMost;
    const bool endsWithText = sections.size() > 1 && showsText(sections.back());
    return sections.size() - (endsWithText ? 1 : 0);
}

std::optional<FormatCondition> usualCondition(std::size_t section, std::size_t count) {
    if (section + 1 == count) return std::nullopt;
    if (section == 1) return FormatCondition{Comparison::Less, 0};
    return FormatCondition{count == 2 ? Comparison::GreaterOrEqual : Comparison::Greater, 0};
}

bool holds(const FormatCondition& condition, double value) {
    switch (condition.comparison) {
        case Comparison::Less:
            return value < condition.number;
        case Comparison::LessOrEqual:
            return value <= condition.number;
        case Comparison::Equal:
            return value == condition.number;
        case Comparison::NotEqual:
            return value != condition.number;
        case Comparison::GreaterOrEqual:
            return value >= condition.number;
        default:
            return value > condition.number;
    }
}

}  // namespace

SectionChoice::SectionChoice(const NumberFormatCode& code) {
    const std::size_t count = countForNumbers(code.sections);
    for (std::size_t i = 0; i < count; ++i) {
        const std::optional<FormatCondition>& own = code.sections[i].condition;
        conditions_.push_back(own ? own : usualCondition(i, count));
    }
}

std::optional<std::size_t> SectionChoice::of(double value) const {
    if (std::isnan(value)) return 0;
    for (std::size_t i = 0; i < conditions_.size(); ++i)
        if (!conditions_[i] || holds(*conditions_[i], value)) return i;
    return std::nullopt;
}

bool SectionChoice::isForNegativesOnly(std::size_t section) const {
    constexpr double kInfinity = std::numeric_limits<double>::infinity();
    // The choice changes only at the numbers of the conditions.
    std::vector<double> samples = {0, kInfinity};
    for (const std::optional<FormatCondition>& condition : conditions_)
        if (condition)
            for (const double end : {-kInfinity, condition->number, kInfinity})
                samples.push_back(std::nextafter(condition->number, end));
    return std::none_of(samples.begin(), samples.end(),
                        [&](double sample) { return sample >= 0 && of(sample) == section; });
}

}  // namespace dp
