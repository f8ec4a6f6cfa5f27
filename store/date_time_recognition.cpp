#include "dpxlsx/store/date_time_recognition.h"

namespace dp {

bool IsDateTime(const IDateTimeVariableFormat* helper, const IString* format, IString* text,
                double& value) {
    return helper->ConvertToDatetime(format, text, value);
}

}  // namespace dp
