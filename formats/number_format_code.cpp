#include "dpxlsx/formats/number_format_code.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstddef>
#include <iterator>
#include <system_error>
#include <utility>

namespace dp {
namespace {

using Kind = FormatToken::Kind;

struct Word {
    std::string_view text;
    Kind kind;
};

// In lower case; a code may have any case.
constexpr Word kWords[] = {{"general", Kind::General},
                           {"am/pm", Kind::DayHalf},
                           {"a/p", Kind::DayHalf},
                           {"上午/下午", Kind::DayHalf}};

struct Letter {
    char letter;
    Kind kind;
};

constexpr Letter kDateLetters[] = {{'y', Kind::Year}, {'e', Kind::Year},  {'b', Kind::Year},
                                   {'g', Kind::Era},  {'m', Kind::Month}, {'d', Kind::Day},
                                   {'h', Kind::Hour}, {'s', Kind::Second}};
constexpr Letter kElapsedLetters[] = {
    {'h', Kind::ElapsedHours}, {'m', Kind::ElapsedMinutes}, {'s', Kind::ElapsedSeconds}};
constexpr Letter kSymbols[] = {
    {'.', Kind::Point}, {',', Kind::Comma}, {'%', Kind::Percent}, {'@', Kind::Text}};

struct Operator {
    std::string_view text;
    FormatCondition::Comparison comparison;
};

// An operator comes before those that it begins with.
constexpr Operator kOperators[] = {{"<=", FormatCondition::Comparison::LessOrEqual},
                                   {"<>", FormatCondition::Comparison::NotEqual},
                                   {"<", FormatCondition::Comparison::Less},
                                   {"=", FormatCondition::Comparison::Equal},
                                   {">=", FormatCondition::Comparison::GreaterOrEqual},
                                   {">", FormatCondition::Comparison::Greater}};

template <std::size_t N>
const Letter* find(const Letter (&table)[N], char c) {
    const Letter* found = std::find_if(std::begin(table), std::end(table),
                                       [c](const Letter& entry) { return entry.letter == c; });
    return found == std::end(table) ? nullptr : found;
}

char lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

std::string lowered(std::string_view text) {
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), lower);
    return result;
}

// The UTF-8 character at the front.
std::size_t characterSize(std::string_view text) {
    std::size_t size = text.empty() ? 0 : 1;
    while (size < text.size() && (text[size] & '\xC0') == '\x80') ++size;
    return size;
}

bool isHour(Kind kind) { return kind == Kind::Hour || kind == Kind::ElapsedHours; }
bool isSecond(Kind kind) { return kind == Kind::Second || kind == Kind::ElapsedSeconds; }

// None unless the text is an operator and a number.
std::optional<FormatCondition> conditionOf(std::string_view text) {
    for (const Operator& each : kOperators) {
        if (!text.starts_with(each.text)) continue;
        text.remove_prefix(each.text.size());
        double number = 0;
        const char* const end = text.data() + text.size();
        const auto result = std::from_chars(text.data(), end, number);
        if (result.ec != std::errc() || result.ptr != end || !std::isfinite(number)) break;
        return FormatCondition{each.comparison, number};
    }
    return std::nullopt;
}

// "m" means minutes right behind the hours or right before the seconds, whatever literals stand
// between them.
void tellMinutesFromMonths(std::vector<FormatToken>& tokens) {
    std::vector<FormatToken*> fields;
    for (FormatToken& token : tokens)
        if (isDateOrTime(token.kind)) fields.push_back(&token);
    for (std::size_t i = 0; i < fields.size(); ++i) {
        FormatToken& field = *fields[i];
        if (field.kind != Kind::Month || field.text.size() > kMostMinuteLetters) continue;
        if ((i > 0 && isHour(fields[i - 1]->kind)) ||
            (i + 1 < fields.size() && isSecond(fields[i + 1]->kind)))
            field.kind = Kind::Minute;
    }
}

class CodeParser {
  public:
    explicit CodeParser(std::string_view code) : rest_(code) {}

    NumberFormatCode run() {
        constexpr std::size_t kMostSections = 4;
        NumberFormatCode code;
        do code.sections.push_back(section());
        while (code.sections.size() < kMostSections && consume(';'));
        return code;
    }

  private:
    FormatSection section() {
        tokens_.clear();
        condition_.reset();
        while (!rest_.empty() && rest_.front() != ';') token();
        tellMinutesFromMonths(tokens_);
        return {std::move(tokens_), condition_};
    }

    void token() {
        if (consume('"')) {
            literal(until('"'));
        } else if (consume('\\')) {
            literal(character());
        } else if (consume('_')) {  // a space as wide as the character
            character();
            literal(" ");
        } else if (consume('*')) {  // fills the cell with the character
            character();
        } else if (consume('[')) {
            bracketed(until(']'));
        } else if (!word() && !calendar() && !exponent() && !dateLetters() && !digits()) {
            symbol();
        }
    }

    bool word() {
        for (const Word& word : kWords) {
            if (lowered(rest_.substr(0, word.text.size())) != word.text) continue;
            add(word.kind, take(word.text.size()));
            return true;
        }
        return false;
    }

    // "B1" chooses the Gregorian and "B2" the Hijri calendar.
    bool calendar() {
        const bool found =
            rest_.size() > 1 && lower(rest_[0]) == 'b' && (rest_[1] == '1' || rest_[1] == '2');
        if (found) take(2);
        return found;
    }

    bool exponent() {
        const bool found = rest_.size() > 1 && lower(rest_[0]) == 'e' &&
                           (rest_[1] == '+' || rest_[1] == '-') && behindDigits();
        if (found) add(Kind::Exponent, take(2));
        return found;
    }

    bool dateLetters() {
        const char letter = lower(rest_.front());
        const Letter* found = find(kDateLetters, letter);
        if (!found) return false;
        std::size_t size = 1;
        while (size < rest_.size() && lower(rest_[size]) == letter) ++size;
        add(found->kind, take(size));
        return true;
    }

    bool digits() {
        const std::size_t size = std::min(rest_.find_first_not_of("0#?"), rest_.size());
        if (size > 0) add(Kind::Digits, take(size));
        return size > 0;
    }

    void symbol() {
        if (const Letter* found = find(kSymbols, rest_.front()))
            add(found->kind, take(1));
        else if (rest_.front() == '/' && behindDigits())
            add(Kind::FractionBar, take(1));
        else
            literal(character());
    }

    void bracketed(std::string_view inside) {
        if (inside.empty()) return;
        if (inside.front() == '$') return literal(inside.substr(1, inside.find('-') - 1));
        if (const auto condition = conditionOf(inside)) condition_ = condition;
        const std::string text = lowered(inside);
        const Letter* elapsed = find(kElapsedLetters, text.front());
        if (elapsed && text.find_first_not_of(text.front()) == text.npos) add(elapsed->kind, text);
    }

    bool behindDigits() const {
        return !tokens_.empty() &&
               (tokens_.back().kind == Kind::Digits || tokens_.back().kind == Kind::Point);
    }

    void add(Kind kind, std::string_view text) { tokens_.push_back({kind, lowered(text)}); }

    void literal(std::string_view text) {
        if (!text.empty()) tokens_.push_back({Kind::Literal, std::string(text)});
    }

    bool consume(char c) {
        const bool found = rest_.starts_with(c);
        if (found) rest_.remove_prefix(1);
        return found;
    }

    std::string_view take(std::size_t size) {
        const std::string_view text = rest_.substr(0, size);
        rest_.remove_prefix(text.size());
        return text;
    }

    std::string_view character() { return take(characterSize(rest_)); }

    // What stands before `end`, which is taken too; all the rest without one.
    std::string_view until(char end) {
        const std::string_view text = take(std::min(rest_.find(end), rest_.size()));
        consume(end);
        return text;
    }

    std::string_view rest_;
    std::vector<FormatToken> tokens_;
    std::optional<FormatCondition> condition_;
};

}  // namespace

bool isDateOrTime(FormatToken::Kind kind) noexcept { return kind >= Kind::Era; }

NumberFormatCode parseNumberFormat(std::string_view code) { return CodeParser(code).run(); }

}  // namespace dp
