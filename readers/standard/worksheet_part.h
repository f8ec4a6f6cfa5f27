#pragma once

#include <functional>
#include <string>

#include "dpxlsx/readers/standard/cell_content.h"
#include "dpxlsx/readers/standard/cell_position.h"

namespace dp::standard {

// Takes the cells of a worksheet part that hold something.
using CellSink = std::function<void(CellPosition, ExternalDataRecordCell&&)>;

// Reads a worksheet part in one pass. Throws CmXmlException, also for a reference that is none, and
// what `sink` throws.
void readWorksheetPart(const std::string& path, CellReferences& references, const CellSink& sink);

}  // namespace dp::standard
