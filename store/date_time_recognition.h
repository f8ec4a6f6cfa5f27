#pragma once

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// True when the helper reads `text` by `format` (null: no pattern known) as a date-time; `value` is
// then its serial day number.
DPXLSX_API bool IsDateTime(const IDateTimeVariableFormat* helper, const IString* format,
                           IString* text, double& value);

}  // namespace dp
