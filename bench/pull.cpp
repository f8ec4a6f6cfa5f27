// For comparisons with other programs, which are processes of their own:
//
// pull BOOK              opens a workbook as a host does and pulls every column of every worksheet
// pull --write DIR [K]   writes the workloads as DIR/NAME.xlsx, with a K-th of the rows (1 by
//                        default), and prints their names

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "bench/workbooks.h"
#include "provider/xlsx_data_provider.h"

namespace {

using bench::Content;

const bench::Workload kWorkloads[] = {
    {"numbers", Content::Numbers, 1, 100000, 20}, {"texts", Content::Texts, 1, 100000, 10},
    {"mixed", Content::Mixed, 1, 100000, 10},     {"wide", Content::Numbers, 1, 1000, 2000},
    {"sheets", Content::Mixed, 100, 1000, 10},    {"small", Content::Mixed, 1, 20, 5}};

int write(const std::string& directory, unsigned part) {
    for (bench::Workload workload : kWorkloads) {
        workload.rows = std::max(1U, workload.rows / part);
        bench::writeWorkbook(directory + "/" + workload.name + ".xlsx", workload);
        std::puts(workload.name);
    }
    return 0;
}

// What a host holds at the end: every column of the workbook, at once.
int pull(const char* book) {
    dp::xlsxDataProvider provider;
    if (provider.OpenFile(book, dp::IDataProvider::FileAccess::Read) != 0) return 1;
    std::vector<dp::IColumn*> columns;
    const auto& worksheets = *provider.GetWorksheetFinder()->GetWorksheetPrimeKeys();
    for (unsigned long sheet = 0; sheet < worksheets.Count(); ++sheet) {
        const auto& keys =
            *provider.GetVariableFinder()->GetColumnPrimeKeys(worksheets.Item(sheet));
        for (unsigned long key = 0; key < keys.Count(); ++key) {
            dp::IColumn* column = nullptr;
            if (!provider.GetVariableFinder()->FindColumn(keys.Item(key), &column, false)) return 1;
            column->AddRef();
            columns.push_back(column);
        }
    }
    provider.CloseFile();
    for (dp::IColumn* column : columns) column->Release();
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc >= 3 && std::strcmp(argv[1], "--write") == 0)
        return write(argv[2],
                     argc > 3 ? static_cast<unsigned>(std::max(1, std::atoi(argv[3]))) : 1);
    if (argc == 2) return pull(argv[1]);
    std::fputs("usage: pull BOOK | pull --write DIRECTORY [PART]\n", stderr);
    return 2;
}
