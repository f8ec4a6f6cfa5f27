#include "dpxlsx/provider/progress_reports.h"

#include <array>
#include <cstddef>
#include <map>
#include <mutex>
#include <new>

namespace dp {

namespace {

// Locked, because providers in different threads share the table.
struct Reports {
    std::mutex mutex;
    std::map<const xlsxDataProvider*, ProgressReport> ofProvider;
};

// Never destroyed, because a host may release its last provider when the process ends, and made
// without memory of its own, because a provider's destructor may be the first to ask.
Reports& reports() {
    alignas(Reports) static std::array<std::byte, sizeof(Reports)> place;
    static Reports& made = *new (place.data()) Reports;
    return made;
}

}  // namespace

void setProgressReport(const xlsxDataProvider& provider, const ProgressReport& report) {
    Reports& all = reports();
    const std::lock_guard lock(all.mutex);
    if (report.report)
        all.ofProvider.insert_or_assign(&provider, report);
    else
        all.ofProvider.erase(&provider);
}

ProgressReport progressReportOf(const xlsxDataProvider& provider) {
    Reports& all = reports();
    const std::lock_guard lock(all.mutex);
    const auto found = all.ofProvider.find(&provider);
    return found == all.ofProvider.end() ? ProgressReport() : found->second;
}

}  // namespace dp
