#include "tools/option_values.h"

#include <charconv>
#include <cmath>

#include "tools/exit_code.h"

namespace dp::tool {

namespace {

template <class T>
struct Word {
    const char* word;
    T value;
};

template <class T, size_t count>
T wordValue(const Word<T> (&words)[count], const std::string& option, const std::string& value,
            const char* expected) {
    for (const Word<T>& entry : words) {
        if (value == entry.word) return entry.value;
    }
    wrongValue(option, value, expected);
}

constexpr Word<EVariableNameRowSetting> kNameSettings[] = {
    {"given", VNR_GIVEN}, {"none", VNR_NONE}, {"infer", VNR_INFER}};

constexpr Word<IVariable::BasicDataType> kTypes[] = {
    {"numeric", IVariable::BasicDataType::Numeric},
    {"text", IVariable::BasicDataType::Text},
    {"datetime", IVariable::BasicDataType::DateTime}};

}  // namespace

void wrongValue(const std::string& option, const std::string& value, const std::string& expected) {
    throw Failure(kUsage,
                  option + ": \"" + value + "\" is not " + expected + "; see dpxlsx --help");
}

double numberValue(const std::string& option, const std::string& value) {
    double number = 0;
    const char* first = value.data() + (value.size() > 1 && value[0] == '+' ? 1 : 0);
    const auto [end, error] = std::from_chars(first, value.data() + value.size(), number);
    const bool whole = error == std::errc() && end == value.data() + value.size();
    if (!whole || !std::isfinite(number)) wrongValue(option, value, "a number such as -99.5");
    return number;
}

NumberOrMissing numberOrMissingValue(const std::string& option, const std::string& value) {
    if (value == "missing") return std::nullopt;
    return numberValue(option, value);
}

unsigned wholeValue(const std::string& option, const std::string& value, unsigned least,
                    unsigned most) {
    unsigned number = 0;
    const auto [end, error] = std::from_chars(value.data(), value.data() + value.size(), number);
    const bool whole = error == std::errc() && end == value.data() + value.size();
    if (!whole || number < least || number > most) {
        wrongValue(option, value,
                   "a whole number from " + std::to_string(least) + " to " + std::to_string(most));
    }
    return number;
}

char symbolValue(const std::string& option, const std::string& value) {
    constexpr const char* kTaken = "0123456789+-";
    const bool one = value.size() == 1 && value[0] > ' ' && value[0] < 0x7F;
    if (!one || std::string(kTaken).find(value[0]) != std::string::npos) {
        wrongValue(option, value, "one character such as \",\"");
    }
    return value[0];
}

std::pair<std::string, std::string> splitValue(const std::string& option, const std::string& value,
                                               char mark) {
    const size_t at = value.find(mark);
    if (at == std::string::npos) {
        wrongValue(option, value, std::string("two values with \"") + mark + "\" in between");
    }
    return {value.substr(0, at), value.substr(at + 1)};
}

ColumnReference columnValue(const std::string& option, const std::string& value) {
    const auto column = parseColumnReference(value);
    if (!column) wrongValue(option, value, "a column such as C, 3 or Sheet1!C");
    return *column;
}

ColumnAssignment assignmentValue(const std::string& option, const std::string& value) {
    const auto assignment = parseColumnAssignment(value);
    if (!assignment) wrongValue(option, value, "a column, \"=\" and a value, such as C=...");
    return *assignment;
}

EVariableNameRowSetting namesValue(const std::string& option, const std::string& value) {
    return wordValue(kNameSettings, option, value, "given, none or infer");
}

IVariable::BasicDataType typeValue(const std::string& option, const std::string& value) {
    return wordValue(kTypes, option, value, "numeric, text or datetime");
}

}  // namespace dp::tool
