#include "dpxlsx/provider/progress_reports.h"

#include <map>

namespace dp {

namespace {

// Made with the first report and never destroyed: a host may release its last provider when the
// process ends.
std::map<const xlsxDataProvider*, ProgressReport>* reports = nullptr;

}  // namespace

void setProgressReport(const xlsxDataProvider& provider, const ProgressReport& report) {
    if (report.report) {
        if (!reports) reports = new std::map<const xlsxDataProvider*, ProgressReport>;
        reports->insert_or_assign(&provider, report);
    } else if (reports) {
        reports->erase(&provider);
    }
}

ProgressReport progressReportOf(const xlsxDataProvider& provider) {
    if (!reports) return {};
    const auto found = reports->find(&provider);
    return found == reports->end() ? ProgressReport() : found->second;
}

}  // namespace dp
