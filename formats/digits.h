#pragma once

namespace dp {

// Whether the character is one of 0 to 9, whatever the locale of the process.
constexpr bool isDigit(char c) { return c >= '0' && c <= '9'; }

}  // namespace dp
