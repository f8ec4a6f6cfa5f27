// Calls that a host makes of a provider, in any order: settings, options, records, queries, and
// opening and closing of a small sound workbook. Columns and worksheets are kept across the calls
// that follow, as hosts keep them.

#include <cstdint>
#include <iterator>
#include <string>
#include <utility>
#include <vector>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_worksheet.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/store/external_data_record.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"
#include "fuzz/input.h"
#include "testkit/package_builder.h"
#include "testkit/process_settings.h"

namespace {

using fuzz::Input;
using fuzz::require;

const std::string& bookPath() {
    static const std::string path = [] {
        const std::string book = fuzz::ownFiles() + "/book.xlsx";
        testkit::PackageBuilder::small().write(book);
        return book;
    }();
    return path;
}

class Host {
  public:
    explicit Host(Input input) : input_(input) {
        dp::IDataProvider* created = nullptr;
        require(dp::CreateDataProvider("xlsx", &created) == 0, "no provider");
        // The provider with all its operations, including those for readers.
        provider_.reset(dynamic_cast<dp::IExcelDataProvider*>(created));
    }

    void run() {
        constexpr int kMostCalls = 100;
        for (int calls = 0; calls < kMostCalls && !input_.empty(); ++calls) {
            const unsigned call = input_.byte();
            if (call % 3 == 0)
                change(call / 3);
            else if (call % 3 == 1)
                setOption(call / 3);
            else
                ask(call / 3);
        }
        fuzz::takeEverything(*provider_);
    }

  private:
    char symbol() { return static_cast<char>(input_.byte()); }
    unsigned key() { return input_.byte() < 240 ? input_.byte() % 8 : input_.index(); }
    int anyKey() { return static_cast<int>(key()); }
    int anyPosition() { return static_cast<int>(key() - 1); }  // -1 included
    std::string name() { return input_.text(); }

    // --- what the provider holds ---
    void change(unsigned call) {
        switch (call % 14) {
            case 0:
            case 1:
            case 2:
            case 3:
            case 4:
                return addRecords();
            case 5:
                return provider_->AddWorksheet(name().c_str());
            case 6:
                return provider_->SetWorksheetIndex(anyPosition());
            case 7:
                return provider_->RemoveWorksheet(anyPosition());
            case 8:
                return open();
            case 9:
                require(provider_->CloseFile() == 0, "not closed");
                require(provider_->GetTempDirectoryPath().empty(), "closed with a directory");
                return;
            case 10:
                return provider_->ClearWorksheets();
            case 12:
                return setRules();
            case 13:
                progress_ = fuzz::ProgressWatch(input_.byte());
                return progress_.watch(*provider_);
            default:
                return list();
        }
    }
    void open() {
        const auto access = dp::IDataProvider::FileAccess(input_.byte() % 8 == 0);
        const char* path = input_.byte() % 8 == 0 ? "nowhere.xlsx" : bookPath().c_str();
        const long result = provider_->OpenFile(path, access);
        require(result == 0 || result == -1 || result == -17 || isEnd(result),
                "another result of opening");
    }
    void setRules() {
        const int rules = static_cast<int>(input_.byte() % 4) - 1;
        const bool exist = rules == 0 || rules == 1;
        require(dp::SetReadingRules(provider_.get(), rules) == (exist ? 0 : -50), "other rules");
    }
    void list() {
        std::vector<std::string> names;
        const long result = provider_->GetWorksheets(bookPath().c_str(), names);
        require((result == 0 && names.size() == 2) || isEnd(result), "not listed");
    }
    bool isEnd(long result) {
        return result == dp::kCancelled && progress_.hasEnded() &&
               provider_->GetTempDirectoryPath().empty();
    }
    // Rarely a large number, because long columns take as long as many short ones.
    unsigned row() {
        const unsigned small = input_.byte();
        if (small < 254) return small;
        const unsigned larger = input_.word();
        return larger == 0xFFFF ? dp::kWorksheetRows - 1 : larger % 1024;
    }
    void addRecords() {
        const unsigned count = 1 + input_.byte() % 8;
        const unsigned step = input_.byte() % 4;
        unsigned row = this->row();
        const unsigned column =
            input_.byte() < 250 ? input_.byte() % 6 : input_.index() % dp::kWorksheetColumns;
        for (unsigned i = 0; i < count && row < dp::kWorksheetRows; ++i, row += step) {
            dp::ExternalDataRecord record(0, 0, row, column);
            fill(record.cell);
            provider_->AddExternalDataRecord(record);
        }
    }
    void fill(dp::ExternalDataRecordCell& cell) {
        constexpr dp::ExternalCellType kTypes[] = {dp::CELL_NUMBER,   dp::CELL_TEXT,
                                                   dp::CELL_DATETIME, dp::CELL_INTEGER,
                                                   dp::CELL_BOOLEAN,  dp::ExternalCellType(0)};
        cell.type = kTypes[input_.byte() % std::size(kTypes)];
        cell.formatIndex = static_cast<int>(input_.byte() % 40) - 1;
        if (cell.type == dp::CELL_TEXT)
            cell.textValue = name();
        else
            cell.numValue = input_.number();
        cell.intValue = static_cast<int>(input_.index());
        cell.boolValue = static_cast<int>(input_.byte() % 3);
    }

    // --- what the host wants ---
    void setOption(unsigned call) {
        const unsigned options = 17;
        return call % (2 * options) < options ? setSetting(call % options)
                                              : setReadOption(call % options);
    }
    void setSetting(unsigned call) {
        switch (call) {
            case 0:
                return provider_->SetMissingValue(input_.number());
            case 1:
                return provider_->SetMissingValueTextRepresentation(name().c_str());
            case 2: {
                const double low = input_.number();
                return provider_->SetNumericRange(low, input_.number());
            }
            case 3:
                return provider_->SetMaximumTextLength(static_cast<int>(input_.index()));
            case 4:
                return provider_->SetInputDecimal(symbol());
            case 5:
                return provider_->SetOutputDecimal(symbol());
            case 6:
                return provider_->SetOutputGroupingSymbol(symbol());
            case 7:
                return provider_->SetBooleanTrueValue(name().c_str());
            case 8:
                return provider_->SetBooleanFalseValue(nullptr);
            case 9: {
                const std::string from = name();
                return provider_->SetMissingText(from.c_str(), name().c_str());
            }
            case 10: {
                const double from = input_.number();
                return provider_->SetMissingNumeric(from, input_.number());
            }
            case 11: {
                const std::string from = name();
                return provider_->SetAlphaMissingNumeric(from.c_str(), input_.number());
            }
            case 12:
                return provider_->SetMaxVariableNameLength(input_.index());
            case 13:
                return provider_->SetDateTimeVariableFormatHelper(input_.flag() ? new fuzz::Helper
                                                                                : nullptr);
            case 14:
                return provider_->SetPreviewing(input_.flag());
            case 15:
                return provider_->SetError(static_cast<long>(input_.index()));
            default:
                return provider_->SetInferFormatPolicy(anyKey());
        }
    }
    void setReadOption(unsigned call) {
        const unsigned sheet = key();
        switch (call) {
            case 0:
                return provider_->SetReadOptionIgnoreBlankRows(input_.flag());
            case 1:
                return provider_->SetReadOptionPadColumnsWithMissingValues(input_.flag());
            case 2:
                return provider_->SetReadOptionCleanTextValues(input_.flag());
            case 3:
                return provider_->SetReadOptionCleanWorksheetNames(input_.flag());
            case 4:
                return provider_->SetReadOptionConvertDateTimeToText(input_.flag());
            case 5:
            case 6: {
                const unsigned names = input_.index();
                return provider_->SetReadOptionDataRowPositions(sheet, nameRow(), names,
                                                                input_.index());
            }
            case 7:
                return provider_->SetReadOptionDefaultUseVariableNameRow(nameRow());
            case 8:
            case 9:
                return provider_->SetReadOptionDataRowCount(sheet, input_.index());
            case 10:
                return provider_->SetReadOptionExclude(sheet, input_.flag());
            case 11:
                return provider_->SetReadColumnOptionExclude(sheet, key(), input_.flag());
            case 12:
            case 13:
                return provider_->SetReadColumnOptionColumnType(
                    sheet, key(), dp::IVariable::BasicDataType(input_.byte() % 5));
            case 14:
                return provider_->SetReadColumnOptionName(sheet, key(), name().c_str());
            case 15:
                return provider_->SetReadColumnOptionDestinationId(sheet, key(), input_.index());
            default:
                return provider_->ClearReadColumnOptions();
        }
    }
    dp::EVariableNameRowSetting nameRow() { return dp::EVariableNameRowSetting(input_.byte() % 4); }

    // --- what the host asks ---
    void ask(unsigned call) {
        switch (call % 8) {
            case 0:
            case 1:
            case 2:
                return findColumn();
            case 3:
                return findWorksheet();
            case 4:
                return askKeys();
            case 5:
                return askSettings();
            case 6:
                return readKept();
            default:
                return callUnsupported();
        }
    }
    // Long columns are released at once.
    void findColumn() {
        const dp::IVariableFinder& finder = *provider_->GetVariableFinder();
        dp::IColumn* column = nullptr;
        dp::IVariableFormat::FormatType type{};
        const auto storage = dp::IVariable::StorageType(input_.byte() % 2);
        const int column_key = anyKey();
        const bool found =
            input_.flag() ? finder.FindColumn(column_key, &column, input_.flag())
                          : finder.FindColumn(column_key, &column, storage, &type, input_.flag());
        require(found == (column != nullptr), "found and not given, or the other way round");
        if (!found) return;
        dp::Reference reference(column);
        constexpr unsigned long kKeptRows = 1000;
        if (fuzz::read(*column) < kKeptRows) columns_.push_back(std::move(reference));
    }
    void findWorksheet() {
        dp::IWorksheet* worksheet = nullptr;
        if (provider_->GetWorksheetFinder()->FindWorksheet(anyKey(), &worksheet))
            worksheets_.emplace_back(worksheet);
    }
    void askKeys() {
        const dp::IVariableFinder& finder = *provider_->GetVariableFinder();
        const auto* sheets = provider_->GetWorksheetFinder()->GetWorksheetPrimeKeys();
        for (unsigned long i = 0; i < sheets->Count(); ++i) {
            const int sheet = sheets->Item(i);
            require(provider_->GetWorksheetFinder()->FindWorksheet(sheet, nullptr), "no worksheet");
            finder.GetColumnPrimeKeys(sheet)->Count();
        }
        finder.GetColumnPrimeKeys(anyKey());
        require(finder.GetConstantPrimeKeys(anyKey())->Count() == 0, "constants");
        provider_->GetWorksheetRowCount(key());
        require(provider_->GetColumn(anyKey(), anyKey()) == nullptr, "a column of the write side");
    }
    void askSettings() {
        std::string all = provider_->GetMissingTextFrom();
        all += provider_->GetMissingTextTo();
        all += provider_->GetAlphaMissingNumericFrom();
        provider_->GetMissingVxlValue();
        provider_->GetMissingNumericFrom();
        provider_->GetError();
    }
    void readKept() {
        for (const auto& column : columns_) fuzz::read(*column);
        for (const auto& worksheet : worksheets_) worksheet->GetTitle();
        if (input_.flag()) columns_.clear();
        if (input_.flag()) worksheets_.clear();
    }
    void callUnsupported() {
        require(provider_->AddDesign(nullptr) == -50, "supported");
        require(provider_->RereadFile() == -1, "read again");
        provider_->SetUnitTesting(input_.flag());
        provider_->AddRef();
        provider_->Release();
    }

    Input input_;
    fuzz::ProgressWatch progress_;
    dp::Reference<dp::IExcelDataProvider> provider_;
    std::vector<dp::Reference<dp::IColumn>> columns_;  // released before the provider
    std::vector<dp::Reference<dp::IWorksheet>> worksheets_;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    bookPath();
    fuzz::leavingNothing([&] {
        const testkit::KeptSettings settings;
        Host(Input(data, size)).run();
    });
    return 0;
}
