#pragma once

#include <string>

namespace dp::tool {

// Usage, every option by group, and the exit codes, for a screen of 50 lines of 80 characters.
std::string helpText();

// Usage and the first group, for a user who gave no argument.
std::string shortHelpText();

// The table of the options as JSON, which the options of the pages are made from.
std::string optionTableText();

}  // namespace dp::tool
