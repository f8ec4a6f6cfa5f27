#pragma once

#include <cstddef>
#include <string>

#include "dpxlsx/readers/xml/plain_xml.h"

namespace dp {

class CellAssembler;

// The two ways to read a worksheet part: both give `cells` its rows, cells and values in the order
// of the document, and throw what `cells` throws.

// The fast one, for plain parts. False when the part turned out not to be plain; `cells` has got
// what came before that.
bool readPlainWorksheet(const std::string& path, CellAssembler& cells,
                        std::size_t chunk = PlainXml::kWindow);

// By libxml2's text reader, for any part. Throws CmXmlException when it cannot be read.
void readAnyWorksheet(const std::string& path, CellAssembler& cells);

}  // namespace dp
