#pragma once

#include <optional>

namespace dp::tool {

// Cells in a line: what the environment variable COLUMNS says, else what the terminal at
// `descriptor` has, else none (a file or a pipe takes lines of any length).
std::optional<int> terminalWidth(int descriptor);

}  // namespace dp::tool
