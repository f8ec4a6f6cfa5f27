// For comparisons with other programs, which are processes of their own:
//
// pull BOOK WORKSHEETS ROWS COLUMNS
//                        opens a workbook as a host does, pulls every column of every worksheet and
//                        looks at every value; fails when there are not as many as that
// pull --write DIR [K]   writes the workloads as DIR/NAME.xlsx, with a K-th of the rows (1 by
//                        default), and prints name, worksheets, rows and columns of each

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "bench/verify.h"
#include "bench/workbooks.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/provider/xlsx_data_provider.h"

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
        std::printf("%s %u %u %u\n", workload.name, workload.sheets, workload.rows,
                    workload.columns);
    }
    return 0;
}

// Columns that a host holds, all at once.
class Columns {
  public:
    void pull(dp::IDataProvider& provider) {
        bench::forEachColumn(provider, [this](dp::IColumn& column) { hold(column); });
    }

    unsigned long values() const { return values_; }
    double sum() const { return sum_; }

  private:
    void hold(dp::IColumn& column) {
        held_.emplace_back(&column);
        values_ += bench::valuesOf(column);
        if (column.GetStorageType() == dp::IVariable::StorageType::Text)
            look(*static_cast<const dp::ITextColumn&>(column).GetTextValues());
        else
            look(static_cast<const dp::INumericColumn&>(column).GetValues(), column.GetRowCount());
    }

    void look(const dp::IReadOnlyCollection<dp::IString&>& texts) {
        for (unsigned long row = 0; row < texts.Count(); ++row)
            sum_ += static_cast<double>(std::strlen(texts.Item(row).database_str()));
    }

    void look(const double* numbers, int count) {
        for (int row = 0; row < count; ++row) sum_ += numbers[row];
    }

    std::vector<dp::Reference<dp::IColumn>> held_;
    unsigned long values_ = 0;  // those that are not missing
    double sum_ = 0;            // of the numbers and the texts' bytes
};

bool pull(const char* book, unsigned long expected) {
    dp::xlsxDataProvider provider;
    provider.SetReadOptionDefaultUseVariableNameRow(dp::VNR_NONE);
    if (provider.OpenFile(book, dp::IDataProvider::FileAccess::Read) != 0) return false;
    Columns columns;
    columns.pull(provider);
    provider.CloseFile();
    return columns.values() == expected && columns.sum() != 0;
}

}  // namespace

int main(int argc, char** argv) {
    const auto number = [argv](int argument) { return std::strtoul(argv[argument], nullptr, 10); };
    if (argc >= 3 && std::strcmp(argv[1], "--write") == 0)
        return write(argv[2], argc > 3 ? std::max(1U, static_cast<unsigned>(number(3))) : 1);
    if (argc >= 5) return pull(argv[1], number(2) * number(3) * number(4)) ? 0 : 1;
    std::fputs("usage: pull BOOK WORKSHEETS ROWS COLUMNS | pull --write DIRECTORY [PART]\n",
               stderr);
    return 2;
}
