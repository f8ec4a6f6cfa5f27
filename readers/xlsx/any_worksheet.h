#pragma once

#include <string>

namespace dp {

class CellAssembler;

// Gives `cells` the rows, cells and values of any worksheet part in the order of the document, by
// libxml2's text reader. Throws CmXmlException when the part cannot be read, and what `cells`
// throws.
void readAnyWorksheet(const std::string& path, CellAssembler& cells);

}  // namespace dp
