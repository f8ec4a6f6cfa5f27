#include "dpxlsx/formats/date_time_translation.h"

#include <algorithm>
#include <cstddef>
#include <utility>
#include <vector>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/elapsed_time_variable_format.h"

namespace dp {
namespace {

using Kind = FormatToken::Kind;

constexpr int kSecond = 1000;  // milliseconds
constexpr int kMinute = 60 * kSecond;
constexpr int kHour = 60 * kMinute;

bool showsTime(Kind kind) { return kind >= Kind::Hour; }

int elapsedUnit(Kind kind) {
    if (kind == Kind::ElapsedHours) return kHour;
    if (kind == Kind::ElapsedMinutes) return kMinute;
    return kind == Kind::ElapsedSeconds ? kSecond : 0;
}

bool isAsciiLetter(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }

// The literal as a pattern. ICU takes letters for fields unless quoted, and two apostrophes for one
// whether quoted or not; so the quotation begins at a letter.
std::string quoted(const std::string& literal) {
    std::string pattern;
    bool open = false;
    for (const char c : literal) {
        if (!open && isAsciiLetter(c)) {
            pattern += '\'';
            open = true;
        }
        pattern.append(c == '\'' ? 2 : 1, c);
    }
    if (open) pattern += '\'';
    return pattern;
}

std::string repeated(char letter, std::size_t count, std::size_t most) {
    return std::string(std::min(count, most), letter);
}

std::string yearPattern(const std::string& letters) {
    return letters.front() != 'e' && letters.size() <= 2 ? "yy" : "yyyy";
}

std::string monthPattern(std::size_t letters) {
    return letters == 5 ? "MMMMM" : repeated('M', letters, 4);  // five: the initial
}

std::string dayPattern(std::size_t letters) {
    return letters <= 2 ? repeated('d', letters, 2) : repeated('E', letters, 4);
}

// The letters for a date or time; none for eras.
std::string fieldPattern(const FormatToken& token, bool halfDays) {
    const std::size_t letters = token.text.size();
    switch (token.kind) {
        case Kind::Year:
            return yearPattern(token.text);
        case Kind::Month:
            return monthPattern(letters);
        case Kind::Day:
            return dayPattern(letters);
        case Kind::Hour:
        case Kind::ElapsedHours:
            return repeated(halfDays ? 'h' : 'H', letters, 2);
        case Kind::Minute:
        case Kind::ElapsedMinutes:
            return repeated('m', letters, 2);
        case Kind::Second:
        case Kind::ElapsedSeconds:
            return repeated('s', letters, 2);
        case Kind::DayHalf:
            return token.text == "a/p" ? "aaaaa" : "a";
        default:
            return {};
    }
}

bool isShownBesideDates(Kind kind) {
    return kind == Kind::Literal || kind == Kind::Point || kind == Kind::Comma ||
           kind == Kind::Percent || kind == Kind::FractionBar;
}

// How counts of elapsed times are translated.
enum class Counts { AsFields, AsMarks };

class Translation {
  public:
    Translation(const FormatSection& section, Counts counts)
        : tokens_(section.tokens), marksCounts_(counts == Counts::AsMarks) {
        halfDays_ = std::any_of(tokens_.begin(), tokens_.end(), [](const FormatToken& token) {
            return token.kind == Kind::DayHalf;
        });
        for (std::size_t i = 0; i < tokens_.size(); ++i) translate(i);
    }

    std::string pattern() const { return pattern_ + quoted(literal_); }
    ElapsedTimeLayout layout() const {
        if (pattern_.empty()) return {literal_, false, counts_};
        return {pattern(), true, counts_};
    }

  private:
    void translate(std::size_t i) {
        const FormatToken& token = tokens_[i];
        if (marksCounts_ && elapsedUnit(token.kind))
            count(token);
        else if (isDateOrTime(token.kind))
            field(fieldPattern(token, halfDays_));
        else if (isFraction(i))
            field(std::string(token.text.size(), 'S'));
        else if (isShownBesideDates(token.kind))
            literal(token.text);
    }

    // Whether it is the digits behind the point of the seconds.
    bool isFraction(std::size_t i) const {
        if (i < 2 || tokens_[i].kind != Kind::Digits || tokens_[i - 1].kind != Kind::Point)
            return false;
        const Kind before = tokens_[i - 2].kind;
        return before == Kind::Second || before == Kind::ElapsedSeconds;
    }

    // The literals before the field are kept until it comes: two quotations in a row would be
    // one with an apostrophe in it.
    void field(const std::string& letters) {
        if (!letters.empty()) pattern_ += quoted(std::exchange(literal_, {})) + letters;
    }

    void literal(std::string text) {
        std::erase(text, ElapsedTimeLayout::kMark);
        literal_ += text;
    }

    void count(const FormatToken& token) {
        literal_ += ElapsedTimeLayout::kMark;
        counts_.push_back({elapsedUnit(token.kind), token.text.size()});
    }

    const std::vector<FormatToken>& tokens_;
    bool marksCounts_;
    bool halfDays_ = false;  // hours count to twelve
    std::string literal_;    // since the last field
    std::string pattern_;    // up to it
    std::vector<ElapsedCount> counts_;
};

}  // namespace

EXCEL_FORMAT_TYPE dateTimeType(const FormatSection& section) {
    bool date = false;
    bool time = false;
    for (const FormatToken& token : section.tokens) {
        if (isDateOrTime(token.kind))
            (showsTime(token.kind) ? time : date) = true;
        else if (!date && !time &&
                 (token.kind == Kind::Digits || token.kind == Kind::General ||
                  token.kind == Kind::Text))
            return EXCEL_FORMAT_NONE;
    }
    if (date) return time ? EXCEL_FORMAT_DATETIME : EXCEL_FORMAT_DATE;
    return time ? EXCEL_FORMAT_TIME : EXCEL_FORMAT_NONE;
}

std::string toIcuPattern(const FormatSection& section) {
    return Translation(section, Counts::AsFields).pattern();
}

std::unique_ptr<IDateTimeVariableFormat> createDateTimeFormat(const FormatSection& section) {
    const std::string pattern = toIcuPattern(section);
    if (std::none_of(section.tokens.begin(), section.tokens.end(),
                     [](const FormatToken& token) { return elapsedUnit(token.kind) != 0; }))
        return std::make_unique<DateTimeVariableFormat>(pattern);
    return std::make_unique<ElapsedTimeVariableFormat>(
        pattern, Translation(section, Counts::AsMarks).layout());
}

}  // namespace dp
