#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "tools/explain/trait.h"
#include "tools/host/workbook.h"

namespace dp::tool {

// The data of a page as JSON: what --json writes of the first rows, a summary of each column, and
// the traits. docs/tool.schema.json describes it.
std::string pageData(Workbook& workbook, const Options& options, const std::vector<Trait>& traits);

// JSON that is safe within an HTML element: whatever its texts are, they neither end the element
// nor a line of its script.
std::string embeddable(std::string_view json);

}  // namespace dp::tool
