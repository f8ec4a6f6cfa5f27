#pragma once

#include <optional>

namespace dp::tool {

// The width of a line in cells: that of the environment variable COLUMNS, else that of the terminal
// at `descriptor`, else none, because a file or a pipe takes lines of any length.
std::optional<int> terminalWidth(int descriptor);

}  // namespace dp::tool
