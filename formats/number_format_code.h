#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The grammar of number-format codes (ISO/IEC 29500-1, 18.8.30 and 18.8.31), read as spreadsheet
// programs read it: what they accept beyond the grammar is accepted, and every text is some code.
namespace dp {

struct FormatToken {
    enum class Kind {
        Literal,  // shown as it stands
        Digits,   // a run of "0", "#" and "?"
        Point,
        Comma,
        Percent,
        FractionBar,  // the "/" behind digits
        Exponent,     // "e+" or "e-" behind digits
        General,
        Text,  // "@", the text of the cell
        // Dates, and from the hour on times:
        Era,
        Year,  // also "e", the year of the era, and "b", the Buddhist year
        Month,
        Day,  // of the month or of the week
        Hour,
        Minute,
        Second,
        DayHalf,  // "am/pm", "a/p" or "上午/下午"
        ElapsedHours,
        ElapsedMinutes,
        ElapsedSeconds,
    };

    Kind kind;
    // What a literal shows, each quotation and each character being one; otherwise as in the code,
    // letters in lower case and without brackets.
    std::string text;
};

// Whether the token shows part of a date, of a time of day or of an elapsed time.
bool isDateOrTime(FormatToken::Kind kind) noexcept;

// "[>=100]": the numbers that a section is for.
struct FormatCondition {
    enum class Comparison { Less, LessOrEqual, Equal, NotEqual, GreaterOrEqual, Greater };

    Comparison comparison;
    double number;  // finite
};

struct FormatSection {
    // Without colours, languages, calendars and fillings, which no format here shows.
    std::vector<FormatToken> tokens;
    std::optional<FormatCondition> condition;  // the last one written
};

// One section at least, possibly empty; four at most, what follows them shows nothing.
struct NumberFormatCode {
    std::vector<FormatSection> sections;
};

// "m" and "mm" are months or minutes, depending on what is next to them; longer ones are months.
inline constexpr int kMostMinuteLetters = 2;

// Takes time and memory in proportion to the code; callers refuse codes of unreasonable size.
NumberFormatCode parseNumberFormat(std::string_view code);

}  // namespace dp
