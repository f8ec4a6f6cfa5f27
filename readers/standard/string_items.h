#pragma once

#include <string>

#include "dpxlsx/readers/standard/element_walker.h"
#include "dpxlsx/readers/xlsx/shared_string_table.h"

namespace dp::standard {

// Decodes "_xHHHH_", in place: every UTF-16 code, a character beyond 16 bits being two escapes.
// Codes that no text of a host can hold stay as they are: 0 and halves of characters.
void decodeEscapes(std::string& text);

// The text of the current element, a shared or inline string: of its `t` and those of its runs.
// Phonetic texts are left out. White space stays, with xml:space and without it.
std::string readStringItem(ElementWalker& walker);

// The texts of a shared-string part, in place of those before. Throws CmXmlException.
void readSharedStrings(const std::string& path, SharedStringTable& table);

}  // namespace dp::standard
