#include "tools/host/workbook.h"

#include <algorithm>
#include <map>

#include <dpxlsx/model/host/i_finders.h>

#include "tools/host/exit_code.h"
#include "tools/host/interrupt.h"
#include "tools/options/column_reference.h"

namespace dp::tool {

namespace {

// For files of another type an .xlsx provider is made too: its OpenFile says what is wrong.
std::string providerType(const Library& library, const std::string& book) {
    const std::string type = library.fileType(book);
    return type.empty() ? "xlsx" : type;
}

std::vector<int> columnKeys(IVariableFinder& finder, int sheet) {
    const IReadOnlyCollection<int>& found = *finder.GetColumnPrimeKeys(sheet);
    std::vector<int> keys;
    for (unsigned long i = 0; i < found.Count(); ++i) keys.push_back(found.Item(i));
    return keys;
}

}  // namespace

Workbook::Workbook(const Library& library, const Options& options)
    : options_(options),
      provider_(library.createProvider(providerType(library, options.book))),
      progress_(options.turn),
      losses_(options) {
    if (options.standard) library.readByStandard(*provider_);
    library.setProgress(
        *provider_,
        [](double done, void* workbook) { return static_cast<Workbook*>(workbook)->note(done); },
        this);
}

Workbook::~Workbook() { provider_->CloseFile(); }

// What the library is answered: 0 lets it go on.
int Workbook::note(double done) {
    progress_.opening(options_.book, done);
    return isInterrupted() ? 1 : 0;
}

std::vector<std::string> Workbook::worksheetNames() {
    std::vector<std::string> names;
    provider_->SetReadOptionCleanWorksheetNames(options_.settings.cleanSheetNames);
    const long result = provider_->GetWorksheets(options_.book.c_str(), names);
    stopIfInterrupted();
    progress_.erase();
    if (result != 0) throw readFailure(options_.book, result);
    return names;
}

void Workbook::open() {
    applySettings(*provider_, options_.settings);
    progress_.opening(options_.book);
    const long result = provider_->OpenFile(options_.book.c_str(), IDataProvider::FileAccess::Read);
    stopIfInterrupted();
    if (result != 0) throw readFailure(options_.book, result);
    try {
        plan_ = applyReadOptions(*provider_, options_);
    } catch (const UnknownWorksheet& unknown) {
        refuse(unknown);
    }
    progress_.erase();
}

// A worksheet without values is in the workbook, but is not imported: the message distinguishes the
// two cases.
void Workbook::refuse(const UnknownWorksheet& unknown) {
    provider_->CloseFile();
    const std::vector<std::string> names = worksheetNames();
    const bool empty = std::find(names.begin(), names.end(), unknown.name()) != names.end();
    throw Failure(
        kUsage,
        options_.book + ": " +
            (empty ? "the worksheet \"" + unknown.name() + "\" has no values and is not imported"
                   : "there is no worksheet \"" + unknown.name() + "\" with values") +
            "; " + unknown.what());
}

std::vector<SheetEntry> Workbook::worksheets() { return listSheets(*provider_); }

size_t Workbook::columnCount(const SheetEntry& sheet) {
    return columnKeys(*provider_->GetVariableFinder(), sheet.key).size();
}

LoadedWorksheet Workbook::load(const SheetEntry& sheet) {
    LoadedWorksheet worksheet{findWorksheet(sheet.key), sheet.key, sheet.title, {}, {}, {}};
    loadColumns(worksheet);
    worksheet.layout = layoutOf(worksheet);
    return worksheet;
}

Reference<IWorksheet> Workbook::findWorksheet(int key) {
    IWorksheet* found = nullptr;
    provider_->GetWorksheetFinder()->FindWorksheet(key, &found);
    return Reference<IWorksheet>(found);
}

void Workbook::loadColumns(LoadedWorksheet& worksheet) {
    IVariableFinder& finder = *provider_->GetVariableFinder();
    const std::vector<int> keys = columnKeys(finder, worksheet.key);
    for (size_t i = 0; i < keys.size(); ++i) {
        stopIfInterrupted();
        progress_.column(worksheet.title, i + 1, keys.size());
        IColumn* column = nullptr;
        if (!finder.FindColumn(keys[i], &column, false)) {
            worksheet.leftOut.insert(numberOf(keys[i], nullptr));
            continue;
        }
        worksheet.columns.emplace_back(column, missing(), options_.settings.preview);
        worksheet.numbers.push_back(numberOf(keys[i], column));
        losses_.note(*provider_,
                     columnReference(worksheet.title, worksheet.key, worksheet.numbers.back()),
                     worksheet.columns.back());
    }
    if (!options_.settings.positions.empty()) notePositions(worksheet);
    progress_.erase();
}

// The column's 1-based number in the worksheet, whatever position an option gave it at the host.
// Without options of columns the position is this number.
unsigned Workbook::numberOf(int key, const IColumn* column) const {
    const auto found = plan_.columnNumbers.find(key);
    if (found != plan_.columnNumbers.end()) return found->second;
    return column == nullptr ? 0 : static_cast<unsigned>(column->GetPosition());
}

// Notes columns at one position; the library accepts that.
void Workbook::notePositions(const LoadedWorksheet& worksheet) {
    std::map<unsigned, std::string> taken;  // columns, by position
    for (size_t i = 0; i < worksheet.columns.size(); ++i) {
        const auto position = static_cast<unsigned>(worksheet.columns[i].host().GetPosition());
        const std::string letters = columnLetters(worksheet.numbers[i]);
        const auto [other, isNew] = taken.emplace(position, letters);
        if (isNew) continue;
        plan_.notes.push_back("columns " + other->second + " and " + letters + " of \"" +
                              worksheet.title + "\" are both at position " +
                              std::to_string(position) +
                              "; give one of them another place: --position COLUMN=N");
    }
}

std::optional<Column> Workbook::asTexts(const Column& column) {
    return loadedAsTexts(*provider_, column, options_.settings.preview);
}

void Workbook::noteShown(const LoadedWorksheet& worksheet) {
    for (size_t i = 0; i < worksheet.columns.size(); ++i) {
        stopIfInterrupted();
        losses_.noteShown(*provider_,
                          columnReference(worksheet.title, worksheet.key, worksheet.numbers[i]),
                          worksheet.columns[i]);
    }
}

std::vector<std::string> Workbook::notes() const {
    std::vector<std::string> notes;
    for (const std::string& note : plan_.notes) notes.push_back(options_.book + ": " + note);
    for (const std::string& note :
         {losses_.cellsNote(), losses_.unreadableNote(), losses_.textsNote()}) {
        if (!note.empty()) notes.push_back(note);
    }
    return notes;
}

Layout Workbook::layoutOf(const LoadedWorksheet& worksheet) const {
    Layout layout{plan_.nameRows.at(worksheet.key), options_.settings.firstRow, 0,
                  provider_->GetWorksheetRowCount(static_cast<unsigned>(worksheet.key))};
    if (layout.firstDataRow == 0) layout.firstDataRow = layout.nameRow + 1;
    for (const Column& column : worksheet.columns) {
        layout.rows = std::max(layout.rows, column.rows());
    }
    return layout;
}

}  // namespace dp::tool
