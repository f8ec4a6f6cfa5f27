#pragma once

#include <string>
#include <utility>

#include "tools/options.h"

// Values of options as the user writes them. A wrong one throws a Failure that names the option.
namespace dp::tool {

[[noreturn]] void wrongValue(const std::string& option, const std::string& value,
                             const std::string& expected);

// A finite number with "." as decimal symbol.
double numberValue(const std::string& option, const std::string& value);
NumberOrMissing numberOrMissingValue(const std::string& option, const std::string& value);
// A whole number from `least` to `most`.
unsigned wholeValue(const std::string& option, const std::string& value, unsigned least,
                    unsigned most);
// One visible ASCII character that is no digit and no sign.
char symbolValue(const std::string& option, const std::string& value);
// Both sides of the first `mark`.
std::pair<std::string, std::string> splitValue(const std::string& option, const std::string& value,
                                               char mark);
ColumnReference columnValue(const std::string& option, const std::string& value);
ColumnAssignment assignmentValue(const std::string& option, const std::string& value);
EVariableNameRowSetting namesValue(const std::string& option, const std::string& value);
IVariable::BasicDataType typeValue(const std::string& option, const std::string& value);

}  // namespace dp::tool
