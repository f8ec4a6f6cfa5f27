#include "fuzz/host.h"

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <vector>

#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/i_worksheet.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/provider/progress_reports.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "fuzz/checks.h"

namespace fuzz {

namespace {

constexpr unsigned long kRows = 20'000;  // of all columns of one input
constexpr unsigned long kShown = 3;      // values of a column

// Reads every byte of the text.
unsigned long read(const dp::IString* text) { return text ? std::strlen(text->database_str()) : 0; }

// Reads and deletes a string that the caller owns.
void show(dp::IString* text) { read(std::unique_ptr<dp::IString>(text).get()); }

void readNumbers(const dp::INumericColumn& column, unsigned long rows) {
    const volatile double* values = column.GetValues();
    const int converted = column.GetConvertedMissingCount();
    require(converted >= 0 && converted <= column.GetRowCount(), "more converted values than rows");
    // Reads every value.
    for (unsigned long row = 0; row < rows; ++row) static_cast<void>(values[row]);
    for (unsigned long row = 0; row < std::min(rows, kShown); ++row) {
        show(column.GetFormat()->FormatValue(values[row], row % 2 == 1));
        show(column.GetFormattedValue(values[row], ','));
    }
}

void readTexts(const dp::ITextColumn& column, unsigned long rows) {
    const auto& texts = *column.GetTextValues();
    require(texts.Count() == rows, "a column of another length");
    for (unsigned long row = 0; row < rows; ++row) read(&texts.Item(row));
}

// Loads columns until kRows rows have been read.
class Taking {
  public:
    explicit Taking(dp::IDataProvider& provider) : finder_(*provider.GetVariableFinder()) {}

    bool enough() const { return rows_ > kRows; }
    void columns(int worksheet) {
        std::vector<int> keys;
        const auto& found = *finder_.GetColumnPrimeKeys(worksheet);
        for (unsigned long i = 0; i < found.Count(); ++i) keys.push_back(found.Item(i));
        for (const int key : keys) {
            if (enough()) return;
            dp::IColumn* column = nullptr;
            if (finder_.FindColumn(key, &column, true)) take(column);
            for (const auto storage :
                 {dp::IVariable::StorageType::Numeric, dp::IVariable::StorageType::Text}) {
                dp::IVariableFormat::FormatType type{};
                if (finder_.FindColumn(key, &column, storage, &type, false)) take(column);
            }
        }
    }

  private:
    void take(dp::IColumn* column) {
        require(column != nullptr, "found and not given");
        rows_ += read(*dp::Reference(column));
    }
    static unsigned long read(dp::IColumn& column) { return fuzz::read(column); }

    dp::IVariableFinder& finder_;
    unsigned long rows_ = 0;
};

}  // namespace

void ProgressWatch::watch(dp::IDataProvider& provider) {
    const auto everyTime = [] {
        static dp::ProgressReport::Time time;
        return time += std::chrono::seconds(1);
    };
    dp::setProgressReport(dynamic_cast<dp::xlsxDataProvider&>(provider),
                          {&ProgressWatch::report, this, everyTime});
}

int ProgressWatch::report(double done, void* watch) {
    ProgressWatch& self = *static_cast<ProgressWatch*>(watch);
    require(done == 0 || (done >= self.done_ && done <= 1), "progress that falls");
    self.done_ = done;
    self.ended_ = self.left_ == 1;
    if (self.left_ > 0) --self.left_;
    return self.ended_ ? 1 : 0;
}

bool Helper::ConvertToDatetime(const dp::IString* format, dp::IString* text, double& value) const {
    read(format);
    char* end = nullptr;
    const double number = std::strtod(text->database_str(), &end);
    if (end == text->database_str()) return false;
    value = number;
    return true;
}

double Helper::GenerateTime(int year, int month, int day, int hour, int minute, int second,
                            int millisecond) const {
    return year * 365.25 + month * 30.5 + day + hour / 24.0 + minute / 1440.0 + second / 86400.0 +
           millisecond / 864e5;
}

bool Helper::ValidVextralTime(double value) const { return value >= 0 && value < 2958466; }

dp::IString* Helper::CovertVextralDateTimeToString(double value) const {
    return FormatValue(value, false);
}

unsigned long read(dp::IColumn& column) {
    const auto rows = static_cast<unsigned long>(column.GetRowCount());
    require(column.GetMissingCount() >= 0 && column.GetMissingCount() <= column.GetRowCount(),
            "more missing values than rows");
    read(column.GetName());
    read(column.GetDescription());
    require(column.GetView() && column.GetFormat(), "a column without view or format");
    if (const auto* numeric = dynamic_cast<dp::INumericColumn*>(&column))
        readNumbers(*numeric, rows);
    else
        readTexts(dynamic_cast<dp::ITextColumn&>(column), rows);
    return rows;
}

void takeEverything(dp::IDataProvider& provider) {
    const dp::IWorksheetFinder& finder = *provider.GetWorksheetFinder();
    std::vector<int> keys;
    const auto& found = *finder.GetWorksheetPrimeKeys();
    for (unsigned long i = 0; i < found.Count(); ++i) keys.push_back(found.Item(i));
    Taking taking(provider);
    for (const int key : keys) {
        dp::IWorksheet* worksheet = nullptr;
        require(finder.FindWorksheet(key, &worksheet), "a worksheet without its key");
        const dp::Reference reference(worksheet);
        require(worksheet->GetPrimeKey() == key, "another worksheet");
        read(worksheet->GetView()->GetMissingValue());
        if (!taking.enough()) taking.columns(key);
    }
}

}  // namespace fuzz
