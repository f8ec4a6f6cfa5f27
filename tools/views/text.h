#pragma once

#include <string>
#include <string_view>

// Texts as a terminal shows them.
namespace dp::tool {

// The text as valid UTF-8: invalid bytes become U+FFFD.
std::string validUtf8(std::string_view text);

// The text on one line, safe for a terminal: control characters become visible symbols, and
// characters that change the writing direction become U+FFFD.
std::string printable(std::string_view text);

// Terminal cells that a printable text takes: 2 for wide characters, 0 for combining ones.
int displayWidth(std::string_view text);

// The text cut to at most `width` cells; the last cell of a cut text is an ellipsis.
std::string cutToWidth(const std::string& text, int width);

// The text followed (or, to the right, preceded) by spaces up to `width` cells.
std::string padded(const std::string& text, int width, bool toTheRight);

// The text without the white space at its ends.
std::string trimmed(const std::string& text);

// "1 cell", "2 cells".
std::string counted(size_t count, const std::string& unit);
std::string counted(size_t count, const std::string& one, const std::string& more);

// The text as one word of a shell's command line, quoted when it needs to be.
std::string shellWord(const std::string& text);

}  // namespace dp::tool
