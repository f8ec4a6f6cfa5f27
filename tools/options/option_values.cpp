#include "tools/options/option_values.h"

#include <charconv>
#include <cmath>
#include <system_error>

#include "tools/host/exit_code.h"

namespace dp::tool {

namespace {

constexpr unsigned kMost = 2147483647;

[[noreturn]] void wrongValue(const Given& given, const std::string& expected) {
    wrongUsage(given.option + ": \"" + given.value + "\" is not " + expected);
}

// The number, if the whole text is one.
template <class T>
std::optional<T> parsed(std::string_view text) {
    T number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return number;
}

template <class T>
struct Word {
    const char* word;
    T value;
};

template <class T, size_t count>
T wordValue(const Word<T> (&words)[count], const Given& given, const char* expected) {
    for (const Word<T>& entry : words) {
        if (given.value == entry.word) return entry.value;
    }
    wrongValue(given, expected);
}

constexpr Word<EVariableNameRowSetting> kNameSettings[] = {
    {"given", VNR_GIVEN}, {"none", VNR_NONE}, {"infer", VNR_INFER}};

constexpr Word<IVariable::BasicDataType> kTypes[] = {
    {"numeric", IVariable::BasicDataType::Numeric},
    {"text", IVariable::BasicDataType::Text},
    {"datetime", IVariable::BasicDataType::DateTime}};

std::pair<Given, Given> splitValue(const Given& given, char mark) {
    const auto& [option, value] = given;
    const size_t at = value.find(mark);
    if (at == std::string::npos) {
        wrongValue(given, std::string("two values with \"") + mark + "\" in between");
    }
    return {{option, value.substr(0, at)}, {option, value.substr(at + 1)}};
}

NumberOrMissing numberOrMissingValue(const Given& given) {
    if (given.value == "missing") return std::nullopt;
    return numberValue(given);
}

}  // namespace

void wrongUsage(const std::string& text) { throw Failure(kUsage, text + "; see dpxlsx --help"); }

std::string textValue(const Given& given) { return given.value; }

double numberValue(const Given& given) {
    const std::string& value = given.value;
    const bool plus = value.size() > 1 && value[0] == '+';
    const auto number = parsed<double>(std::string_view(value).substr(plus ? 1 : 0));
    if (!number || !std::isfinite(*number)) wrongValue(given, "a number such as -99.5");
    return *number;
}

unsigned wholeValue(const Given& given, unsigned least, unsigned most) {
    const auto number = parsed<unsigned>(given.value);
    if (!number || *number < least || *number > most) {
        wrongValue(given,
                   "a whole number from " + std::to_string(least) + " to " + std::to_string(most));
    }
    return *number;
}

char symbolValue(const Given& given) {
    constexpr std::string_view kTaken = "0123456789+-";
    const std::string& value = given.value;
    const bool one = value.size() == 1 && value[0] > ' ' && value[0] < 0x7F;
    if (!one || kTaken.find(value[0]) != std::string_view::npos) {
        wrongValue(given, "one character such as \",\"");
    }
    return value[0];
}

int limitValue(const Given& given) {
    return given.value == "none" ? kNoLimit : static_cast<int>(wholeValue(given, 1, kMost));
}

EVariableNameRowSetting namesValue(const Given& given) {
    return wordValue(kNameSettings, given, "given, none or infer");
}

std::pair<double, double> rangeValue(const Given& given) {
    const auto [least, most] = splitValue(given, ':');
    return {numberValue(least), numberValue(most)};
}

std::pair<NumberOrMissing, NumberOrMissing> numberForNumber(const Given& given) {
    const auto [from, to] = splitValue(given, '=');
    return {numberOrMissingValue(from), numberOrMissingValue(to)};
}

std::pair<std::string, NumberOrMissing> numberForText(const Given& given) {
    const auto [from, to] = splitValue(given, '=');
    return {from.value, numberOrMissingValue(to)};
}

std::pair<std::string, std::string> textForText(const Given& given) {
    const auto [from, to] = splitValue(given, '=');
    return {from.value, to.value};
}

ColumnReference columnValue(const Given& given) {
    const auto column = parseColumnReference(given.value);
    if (!column) wrongValue(given, "a column such as C, 3 or Sheet1!C");
    return *column;
}

ColumnAssignment columnText(const Given& given) {
    const auto assignment = parseColumnAssignment(given.value);
    if (!assignment) wrongValue(given, "a column, \"=\" and a value, such as C=...");
    return *assignment;
}

std::pair<ColumnReference, IVariable::BasicDataType> columnType(const Given& given) {
    const auto [column, kind] = columnText(given);
    return {column, wordValue(kTypes, {given.option, kind}, "numeric, text or datetime")};
}

std::pair<ColumnReference, unsigned> columnPosition(const Given& given) {
    const auto [column, place] = columnText(given);
    return {column, wholeValue({given.option, place}, 1, kMost)};
}

}  // namespace dp::tool
