#pragma once

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// Asks the host's helper, which must not be null, to read `text` by the ICU pattern `format`; null
// stands for no known pattern. If the helper can, returns true and sets `value` to the serial day
// number.
DPXLSX_API bool IsDateTime(const IDateTimeVariableFormat* helper, const IString* format,
                           IString* text, double& value);

}  // namespace dp
