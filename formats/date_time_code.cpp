#include <cstddef>
#include <string_view>
#include <utility>

#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/formats/input_decimal.h"
#include "dpxlsx/formats/number_format_code.h"

namespace dp {
namespace {

constexpr int kMostFractionDigits = 3;

// Reads the first section of a code and finds out whether it shows a date, a time or both. Quoted
// and bracketed words are read like everything else.
class DateTimeScan {
  public:
    explicit DateTimeScan(std::string section) : text_(std::move(section)) {}

    EXCEL_FORMAT_TYPE run() {
        while (at_ < text_.size() && !(date_ && time_)) step();
        if (pendingMonthOrMinute_ > 0) date_ = true;
        if (date_) return time_ ? EXCEL_FORMAT_DATETIME : EXCEL_FORMAT_DATE;
        return time_ ? EXCEL_FORMAT_TIME : EXCEL_FORMAT_NONE;
    }

    // The section; fractional seconds are rewritten in the part that was read.
    std::string takeText() { return std::move(text_); }

  private:
    void step() {
        const char letter = text_[at_++];
        switch (letter) {
            case 'd':
            case 'y':
                date_ = true;
                return settle(letter);
            case 'h':
                return hours();
            case 'm':
                return monthsOrMinutes();
            case 's':
                return seconds();
            case 'Q':
                return pair("q");
            case 'q':
                return pair("Q");
            case 'W':
                return pair("kw");
            case '[':
                bracket_ = true;
                return;
            case '.':
                return fraction();
            default:
                return;
        }
    }

    void settle(char letter) {
        pendingMonthOrMinute_ = 0;
        previous_ = letter;
    }

    void hours() {
        if (pendingMonthOrMinute_ > 0) date_ = true;
        time_ = true;
        settle('h');
    }

    void monthsOrMinutes() {
        ++pendingMonthOrMinute_;
        if (previous_ != 'h') {
            previous_ = 'm';
            return;
        }
        for (; at_ < text_.size() && text_[at_] == 'm'; ++at_) ++pendingMonthOrMinute_;
        (pendingMonthOrMinute_ > kMostMinuteLetters ? date_ : time_) = true;
        settle('m');
    }

    void seconds() {
        if (pendingMonthOrMinute_ > kMostMinuteLetters) date_ = true;
        time_ = true;
        settle('s');
    }

    // Quarters and weeks: two letters, the second one of `partners`.
    void pair(std::string_view partners) {
        if (at_ == text_.size() || partners.find(text_[at_]) == partners.npos) return;
        date_ = true;
        ++at_;
    }

    // The point behind the seconds of a code such as "[h]:mm:ss.000".
    void fraction() {
        if (!bracket_ || previous_ != 's') return;
        text_[at_ - 1] = inputDecimal();
        for (int i = 0; i < kMostFractionDigits && at_ < text_.size() && text_[at_] == '0'; ++i)
            text_[at_++] = 's';
    }

    std::string text_;
    std::size_t at_ = 0;
    bool date_ = false;
    bool time_ = false;
    bool bracket_ = false;
    int pendingMonthOrMinute_ = 0;
    char previous_ = ' ';
};

// Drops a locale tag such as "[$-409]" and what stands before it.
void removeLocaleTag(std::string& code) {
    const std::size_t tag = code.find(LANG_ID_MASK);
    if (tag == std::string::npos) return;
    const std::size_t end = code.find(']', tag);
    if (end != std::string::npos) code.erase(0, end + 1);
}

}  // namespace

bool parseDateTimeFormat(const std::string& code, std::string& cleaned, EXCEL_FORMAT_TYPE& type) {
    cleaned = code;
    removeBackslashes(cleaned);
    removeLocaleTag(cleaned);

    DateTimeScan scan(cleaned.substr(0, cleaned.find(FORMAT_TOKEN_SEPARATOR.front())));
    const EXCEL_FORMAT_TYPE found = scan.run();
    if (found == EXCEL_FORMAT_NONE) return false;
    type = found;
    cleaned = scan.takeText();
    return true;
}

}  // namespace dp
