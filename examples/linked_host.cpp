// linked_host BOOK.xlsx: prints the columns of the workbook's first worksheet by the import library
// that it is linked with.
#include <cstdio>

#include <dpxlsx/model/host/entry_points.h>
#include <dpxlsx/model/host/i_column.h>
#include <dpxlsx/model/host/i_data_provider.h>
#include <dpxlsx/model/host/i_finders.h>
#include <dpxlsx/model/host/i_string.h>
#include <dpxlsx/model/host/reference.h>

static long printColumns(dp::IDataProvider& provider, const char* book) {
    const long result = provider.OpenFile(book, dp::IDataProvider::FileAccess::Read);
    if (result != 0) return result;
    const auto& sheets = *provider.GetWorksheetFinder()->GetWorksheetPrimeKeys();
    if (sheets.Count() == 0) return 0;
    const dp::IVariableFinder& finder = *provider.GetVariableFinder();
    const auto& keys = *finder.GetColumnPrimeKeys(sheets.Item(0));
    for (unsigned long i = 0; i < keys.Count(); ++i) {
        dp::IColumn* loaded = nullptr;
        if (!finder.FindColumn(keys.Item(i), &loaded, false)) continue;
        const dp::Reference<dp::IColumn> column(loaded);
        std::printf("%s: type %d, %d rows, %d missing\n", column->GetName()->application_str(),
                    column->GetDataType(), column->GetRowCount(), column->GetMissingCount());
    }
    return 0;
}

int main(int count, char** arguments) {
    if (count < 2) return 2;
    dp::IDataProvider* made = nullptr;
    if (dp::CreateDataProvider("xlsx", &made) != 0) return 1;
    const dp::Reference<dp::IDataProvider> provider(made);
    long result = -1;
    try {
        result = printColumns(*provider, arguments[1]);
    } catch (...) {  // a part that cannot be read, the file system, or memory
    }
    if (result != 0) std::fprintf(stderr, "%s: result %ld\n", arguments[1], result);
    provider->CloseFile();
    return result == 0 ? 0 : 1;
}
