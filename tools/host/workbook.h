#pragma once

#include <optional>
#include <set>
#include <string>
#include <vector>

#include <dpxlsx/model/host/i_data_provider.h>
#include <dpxlsx/model/host/i_worksheet.h>
#include <dpxlsx/model/host/reference.h>

#include "tools/host/column.h"
#include "tools/host/library.h"
#include "tools/host/losses.h"
#include "tools/host/progress.h"
#include "tools/options/options.h"
#include "tools/options/settings.h"

namespace dp::tool {

// The rows of a worksheet that its values come from, 1-based.
struct Layout {
    unsigned nameRow;       // 0 for none
    unsigned firstDataRow;  // where data starts
    size_t rows;            // of the longest column
    unsigned usedRows;      // the last row with a cell
};

struct LoadedWorksheet {
    Reference<IWorksheet> host;
    int key;
    std::string title;
    Layout layout;
    std::vector<Column> columns;      // those that are not excluded
    std::vector<unsigned> numbers;    // their 1-based numbers in the worksheet
    std::set<unsigned> leftOut = {};  // the numbers of the others
};

// A workbook in a provider, which the destructor closes, so that nothing is left on disk.
// Operations throw a Failure when the library reports one, and let the library's own exceptions
// through.
class Workbook {
  public:
    Workbook(const Library& library, const Options& options);
    ~Workbook();
    Workbook(const Workbook&) = delete;
    Workbook& operator=(const Workbook&) = delete;

    // The names of all worksheets, without reading any cell. Not while the workbook is open.
    std::vector<std::string> worksheetNames();

    // Passes the settings to the provider, reads the workbook, and passes the options of its
    // worksheets.
    void open();
    // The worksheets that the options select, in workbook order.
    std::vector<SheetEntry> worksheets();
    size_t columnCount(const SheetEntry& sheet);
    LoadedWorksheet load(const SheetEntry& sheet);

    // The column loaded as texts, which have the content of cells that did not fit its kind; none
    // when an option forces the kind.
    std::optional<Column> asTexts(const Column& column);
    // Counts, in the columns of texts, the numbers and dates that do not arrive in full.
    void noteShown(const LoadedWorksheet& worksheet);
    // What was lost of the columns loaded so far.
    const Losses& losses() const { return losses_; }
    // The titles of the worksheets that options leave out.
    const std::set<std::string>& leftOut() const { return plan_.leftOut; }
    // What the user would not notice in the output, one line each: messages about options without
    // effect, and what was lost.
    std::vector<std::string> notes() const;
    // Where the library has unpacked the open workbook.
    std::string folder() const { return provider_->GetTempDirectoryPath(); }

    // The number that marks a missing value.
    double missing() const { return options_.settings.missing.value_or(kDefaultMissing); }

  private:
    int note(double done);
    [[noreturn]] void refuse(const UnknownWorksheet& unknown);
    Reference<IWorksheet> findWorksheet(int key);
    void loadColumns(LoadedWorksheet& worksheet);
    unsigned numberOf(int key, const IColumn* column) const;
    void notePositions(const LoadedWorksheet& worksheet);
    Layout layoutOf(const LoadedWorksheet& worksheet) const;

    const Options& options_;
    Reference<IDataProvider> provider_;
    Progress progress_;
    Losses losses_;
    ReadPlan plan_;
};

}  // namespace dp::tool
