#include "model/worksheet.h"

#include "model/reference_count.h"

namespace dp {

Worksheet::~Worksheet() = default;

void Worksheet::Release() {
    if (releaseReference(refCount)) delete this;
}

}  // namespace dp
