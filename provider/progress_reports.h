#pragma once

#include "dpxlsx/readers/xml/progress.h"

namespace dp {

class xlsxDataProvider;

// The reports that hosts have set, by provider. They are kept beside the providers: a field would
// move those of the classes that hosts derive.

// Sets the report of a provider; one that tells nobody is forgotten.
void setProgressReport(const xlsxDataProvider& provider, const ProgressReport& report);

// The report that was set last; else one that tells nobody.
ProgressReport progressReportOf(const xlsxDataProvider& provider);

}  // namespace dp
