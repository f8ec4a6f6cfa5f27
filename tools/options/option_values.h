#pragma once

#include <string>
#include <utility>

#include "tools/options/options.h"

// Values of options as the user writes them. A wrong value throws a Failure that names the option.
namespace dp::tool {

// An option of the command line with the value that it was given, empty for none.
struct Given {
    std::string option;
    std::string value;
};

constexpr const char* kOneView =
    "choose one of --list, --csv, --json, --page and --explain, or --explain with --json";

// Throws a Failure for wrong usage.
[[noreturn]] void wrongUsage(const std::string& text);

std::string textValue(const Given& given);
// A finite number with "." as decimal symbol.
double numberValue(const Given& given);
// A whole number from `least` to `most`.
unsigned wholeValue(const Given& given, unsigned least, unsigned most);
// A number of bytes, or kNoLimit for "none".
int limitValue(const Given& given);
// One visible ASCII character that is no digit and no sign.
char symbolValue(const Given& given);
EVariableNameRowSetting namesValue(const Given& given);

// Two values with a mark in between: MIN:MAX, OLD=NEW.
std::pair<double, double> rangeValue(const Given& given);
std::pair<NumberOrMissing, NumberOrMissing> numberForNumber(const Given& given);
std::pair<std::string, NumberOrMissing> numberForText(const Given& given);
std::pair<std::string, std::string> textForText(const Given& given);

// A column, alone or with a value for it.
ColumnReference columnValue(const Given& given);
ColumnAssignment columnText(const Given& given);
std::pair<ColumnReference, IVariable::BasicDataType> columnType(const Given& given);
std::pair<ColumnReference, unsigned> columnPosition(const Given& given);

}  // namespace dp::tool
