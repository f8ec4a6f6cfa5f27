#include "dpxlsx/model/host/entry_points.h"

#include <cstring>

#include "dpxlsx/model/string.h"
#include "dpxlsx/provider/file_type.h"
#include "dpxlsx/provider/progress_reports.h"
#include "dpxlsx/provider/xlsx_data_provider.h"

namespace dp {

namespace {

constexpr char kTypeName[] = "xlsx";
constexpr long kFailed = -1;
constexpr long kUnsupported = -50;

}  // namespace

bool IsMicrosoftXLSXFile(const char* fileName) { return hasXlsxExtension(textOrEmpty(fileName)); }

const char* GetDataProviderFiletype(const char* fileName) {
    thread_local char fileType[sizeof kTypeName];
    // The buffer always holds the name; a zero as its first byte makes it empty.
    std::memcpy(fileType, kTypeName, sizeof kTypeName);
    if (!IsMicrosoftXLSXFile(fileName)) fileType[0] = '\0';
    return fileType;
}

long CreateDataProvider(const char* typeName, IDataProvider** provider) {
    constexpr long kUnknownType = -22;
    if (!provider) return kFailed;
    *provider = nullptr;
    if (std::strcmp(textOrEmpty(typeName), kTypeName) != 0) return kUnknownType;
    try {
        *provider = new xlsxDataProvider;
    } catch (...) {
        return kFailed;
    }
    return 0;
}

long SetReadingRules(IDataProvider* provider, int rules) {
    auto* const own = dynamic_cast<ExcelDataProviderBase*>(provider);
    const bool known = rules == static_cast<int>(ReadingRules::Default) ||
                       rules == static_cast<int>(ReadingRules::Standard);
    if (!own || !known) return kUnsupported;
    own->setReadingRules(static_cast<ReadingRules>(rules));
    return 0;
}

long SetProgress(IDataProvider* provider, int (*report)(double done, void* user), void* user) {
    const auto* const own = dynamic_cast<xlsxDataProvider*>(provider);
    if (!own) return kUnsupported;
    try {
        setProgressReport(*own, {.report = report, .user = user});
    } catch (...) {
        return kFailed;
    }
    return 0;
}

}  // namespace dp
