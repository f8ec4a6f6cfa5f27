#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "dpxlsx/model/host/export.h"

// Cleaning of texts and names, in place. White space and control characters are those of the
// platform's character classification, byte by byte.
namespace dp {

// Removes white space at both ends, or at the start.
DPXLSX_API void trim(std::string& text);
DPXLSX_API void ltrim(std::string& text);

// Trims, removes control characters and makes every run of spaces one space. A space that comes to
// the end only because control characters are removed stays.
DPXLSX_API void CleanText(std::string& text);

// Replaces the characters that worksheet names may not have by "_", then trims.
DPXLSX_API void CleanWorksheetName(std::string& name);

// Keeps the first `maxChars` user-perceived characters; 0 keeps the text as it is.
DPXLSX_API void truncateToCharLength(std::string& text, unsigned short maxChars);

// Makes a text fit for a variable name of at most `maxChars` characters: line feeds become spaces,
// white space at the ends goes, and characters that the host's names cannot have become "_".
void cleanVariableName(std::string& name, unsigned short maxChars);

// How many of the first `bytes` bytes make up whole user-perceived characters, which may be
// several code points; where the first one alone is longer, whole code points. `bytes` is less than
// the text has.
std::size_t wholeCharacters(std::string_view text, std::size_t bytes);

// True for the empty text and for one of spaces (0x20) only; tabs and line breaks are content.
bool isAllSpaces(std::string_view text);

}  // namespace dp
