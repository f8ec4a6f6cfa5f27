#pragma once

#include <string>

#include "dpxlsx/readers/xml/plain_xml.h"

namespace dp {

class CellAssembler;

// Does what readAnyWorksheet does for a plain part, several times as fast. False when the part
// turned out not to be plain; `cells` has got what came before that.
bool readPlainWorksheet(const std::string& path, CellAssembler& cells, ReadingWindow window = {});

}  // namespace dp
