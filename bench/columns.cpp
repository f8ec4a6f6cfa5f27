// The cost of loading columns on demand. Cells are filed directly; columns are requested as a host
// does.

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <numeric>
#include <random>
#include <string>
#include <vector>

#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>

#include "bench/harness.h"
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/store/text_cleaning.h"
#include "testkit/providers.h"

namespace {

using bench::addLoops;
using bench::kNoGoal;
using bench::Loop;
using bench::Report;

constexpr unsigned kRows = 1'000'000;
constexpr char kPattern[] = "M/d/yyyy H:mm";
constexpr int kDateStyle = 1;

volatile double sink = 0;  // keeps the results alive

class Provider : public testkit::FilingProvider {
  public:
    explicit Provider(unsigned worksheets = 1) {
        while (worksheets-- > 0) AddWorksheet(static_cast<const char*>("sheet"));
        SetWorksheetIndex(0);
    }

    dp::IVariableFormat* CreateVextralNumericFormat(
        const dp::ExternalDataRecordCell& cell) const override {
        if (cell.formatIndex == kDateStyle)
            return new dp::DateTimeVariableFormat(std::string(kPattern));
        auto format = std::make_unique<dp::NumericVariableFormat>();
        format->autoFormat = true;
        return format.release();
    }
    bool IsDateTimeFormatType(const dp::ExternalDataRecordCell& cell) const override {
        return cell.formatIndex == kDateStyle;
    }

    void number(unsigned row, unsigned column, double value, int style = -1) {
        cell_.type = dp::CELL_NUMBER;
        cell_.numValue = value;
        cell_.formatIndex = style;
        file(row, column, cell_);
    }
    void text(unsigned row, unsigned column, const std::string& value) {
        cell_.type = dp::CELL_TEXT;
        cell_.textValue = value;
        cell_.formatIndex = -1;
        file(row, column, cell_);
    }

    // Loads a column and releases it. The first row holds the name. Returns the number of rows, of
    // which that many are not missing.
    double load(int key, unsigned values, dp::ColumnType type = dp::ColumnType::Automatic) const {
        dp::IColumn* found = nullptr;
        dp::IVariableFormat::FormatType formatType{};
        bench::require(FindColumn(key, &found, type, &formatType, false), "no column");
        const dp::Reference<dp::IColumn> column(found);
        bench::requireCount(bench::valuesOf(*column), values, "values");
        return column->GetRowCount();
    }
    // Loads the first column.
    Loop loading(unsigned values = kRows, dp::ColumnType type = dp::ColumnType::Automatic) {
        GetWorksheetPrimeKeys();
        return [this, values, type] { return load(1, values, type); };
    }
    unsigned long blankRows() const {
        return _blankRows.empty() ? 0 : _blankRows.begin()->second.size();
    }
    const dp::WorksheetCells& cells() const { return _cells.front(); }
    void forgetBlankRows() { _blankRows.clear(); }

  private:
    dp::ExternalDataRecordCell cell_;
};

std::string customer(unsigned number) {
    char text[32];
    std::snprintf(text, sizeof text, "customer number %010u", number);
    return text;
}

// Copies what `valueOf` takes of each cell of the first column.
template <class Value, class ValueOf>
Loop copying(const Provider& provider, ValueOf valueOf) {
    return [&provider, valueOf] {
        const dp::CellColumn& column = provider.cells().begin()->second;
        std::vector<Value> values;
        values.reserve(column.size());
        for (auto cell = column.begin(); cell != column.end(); ++cell)
            values.emplace_back(valueOf(cell->second));
        return static_cast<double>(values.size());
    };
}

void numbers(Report& report) {
    Provider full;
    Provider gaps;
    Provider dates;
    // Every other row is empty in this column, but has a cell in another one.
    Provider sparse;
    for (unsigned row = 0; row <= kRows; ++row) {
        full.number(row, 0, row * 0.5);
        if (row % 100 != 50) gaps.number(row, 0, row * 0.5);
        dates.number(row, 0, row * 0.5, kDateStyle);
        sparse.number(row, row % 2, row * 0.5);
    }
    gaps.SetReadOptionIgnoreBlankRows(true);
    sparse.SetReadOptionIgnoreBlankRows(true);
    sparse.SetMissingNumeric(dp::ExcelDataProviderBase::_missingValue, -1);
    const Loop copy =
        copying<double>(full, [](const dp::CellView& cell) { return cell.numValue(); });
    addLoops(report, "numbers / a copying walk, ns", {4, 10}, full.loading(), copy);
    addLoops(report, "date-times / a copying walk, ns", {4, 10}, dates.loading(), copy);
    addLoops(report, "numbers, 1 % blank rows skipped / none, ns", {2},
             gaps.loading(kRows - kRows / 100), full.loading());
    addLoops(report, "numbers, every other one missing / none, ns", {4}, sparse.loading(kRows / 2),
             full.loading());
}

void blankRows(Report& report) {
    constexpr unsigned kColumns = 20;
    Provider provider;
    for (unsigned row = 0; row < kRows; ++row)
        for (unsigned column = 0; column < kColumns; ++column)
            if (row % 100 != 50) provider.number(row, column, row);
    provider.SetReadOptionIgnoreBlankRows(true);
    const auto search = [&provider] {
        provider.forgetBlankRows();
        provider.FindBlankRows(1);
        bench::requireCount(provider.blankRows(), kRows / 100, "blank rows");
        return double{kRows} * kColumns;
    };
    const auto walk = [&provider] {
        unsigned rows = 0;
        for (const auto& column : provider.cells())
            for (auto cell = column.second.begin(); cell != column.second.end(); ++cell)
                rows += cell->first;
        sink = rows;
        return double{kRows} * kColumns;
    };
    addLoops(report, "blank rows, a cell of 20 columns / a walk, ns", {kNoGoal, 10}, search, walk);
}

// Renders as many date-times as there are rows.
Loop icuRendering() {
    UErrorCode status = U_ZERO_ERROR;
    const auto format = std::make_shared<icu::SimpleDateFormat>(
        icu::UnicodeString::fromUTF8(kPattern), icu::Locale::getUS(), status);
    format->setTimeZone(*icu::TimeZone::getGMT());
    return [format] {
        icu::UnicodeString output;
        std::string utf8;
        return bench::times(kRows, [&](int row) {
            output.remove();
            utf8.clear();
            format->format((40000 + row * 0.125 - 25569) * 86400000, output);
            output.toUTF8String(utf8);
            return !utf8.empty();
        });
    };
}

void rendering(Report& report) {
    Provider values;
    Provider dates;
    for (unsigned row = 0; row <= kRows; ++row) {
        const double value = static_cast<double>(row * 7919ULL % 10'000'000);
        values.number(row, 0, row % 3 == 0 ? value : row % 3 == 1 ? value / 100 : value / 7);
        dates.number(row, 0, 40000 + row * 0.125, kDateStyle);
    }
    addLoops(report, "numbers as text, ns", {kNoGoal, 400},
             values.loading(kRows, dp::ColumnType::Text));
    addLoops(report, "date-times as text / ICU alone, ns", {1.5},
             dates.loading(kRows, dp::ColumnType::Text), icuRendering());
}

void texts(Report& report) {
    Provider customers;
    Provider numbers;
    std::vector<std::string> kept;
    for (unsigned row = 0; row <= kRows; ++row) {
        customers.text(row, 0, customer(static_cast<unsigned>(row * 7919ULL % (kRows / 2))));
        kept.push_back(std::to_string(row % 10007) + "." + std::to_string(row % 97));
        numbers.text(row, 0, kept.back());
    }
    addLoops(report, "texts of 26 bytes, half distinct / copies, ns", {kNoGoal, 130},
             customers.loading(), copying<std::string>(customers, [](const dp::CellView& cell) {
                 return cell.textValue();
             }));
    addLoops(report, "numeric texts as numbers / strtod, ns", {3},
             numbers.loading(kRows, dp::ColumnType::Numeric), [&kept] {
                 double sum = 0;
                 for (const std::string& text : kept) sum += std::strtod(text.c_str(), nullptr);
                 sink = sum;
                 return static_cast<double>(kept.size());
             });
}

// Files one column and loads it. Reading a cell from a file takes some hundred nanoseconds more;
// the goal of at most one and a half times for rows out of order is set for the sum, not for this
// part.
Loop filing(const std::vector<unsigned>& rows) {
    return [&rows] {
        Provider provider;
        for (const unsigned row : rows) provider.number(row, 0, row);
        provider.GetWorksheetPrimeKeys();
        provider.load(1, static_cast<unsigned>(rows.size()) - 1);
        return static_cast<double>(rows.size());
    };
}

void orders(Report& report) {
    for (const unsigned count : {100'000U, kRows}) {
        std::vector<unsigned> ascending(count);
        std::iota(ascending.begin(), ascending.end(), 0U);
        std::vector<unsigned> rows(ascending.rbegin(), ascending.rend());
        const std::string many = std::to_string(count) + " rows filed and loaded, ";
        addLoops(report, many + "descending, ns", {}, filing(rows), filing(ascending));
        std::shuffle(rows.begin(), rows.end(), std::mt19937(1));
        addLoops(report, many + "random, ns", {}, filing(rows), filing(ascending));
    }
}

// Finds all columns of a workbook of many tiny columns by their keys.
Loop findingAll(unsigned worksheets, unsigned columns) {
    const auto provider = std::make_shared<Provider>(worksheets);
    for (unsigned sheet = 0; sheet < worksheets; ++sheet) {
        provider->SetWorksheetIndex(static_cast<int>(sheet));
        for (unsigned column = 0; column < columns; ++column)
            for (unsigned row = 0; row < 3; ++row) provider->number(row, column, row);
    }
    provider->GetWorksheetPrimeKeys();
    return [provider, worksheets, columns] {
        unsigned long found = 0;
        for (unsigned sheet = 1; sheet <= worksheets; ++sheet) {
            const auto* keys = provider->GetColumnPrimeKeys(static_cast<int>(sheet));
            found += keys->Count();
            for (unsigned long i = 0; i < keys->Count(); ++i) provider->load(keys->Item(i), 2);
        }
        bench::requireCount(found, 1UL * worksheets * columns, "columns");
        return static_cast<double>(found);
    };
}

void finding(Report& report) {
    // As often as it takes to measure it.
    const Loop few = [once = findingAll(10, 10)] {
        double found = 0;
        for (int i = 0; i < 100; ++i) found += once();
        return found;
    };
    addLoops(report, "finding 10 x 10,000 columns / 10 x 10, ns", {2}, findingAll(10, 10'000), few);
    addLoops(report, "finding 10,000 x 10 columns / 10 x 10, ns", {2}, findingAll(10'000, 10), few);
}

// Cuts the name to 31 characters.
Loop cutting(const std::string& name) {
    return [name] {
        return bench::times(10000, [&name](int) {
            std::string text = name;
            dp::truncateToCharLength(text, 31);
            return !text.empty();
        });
    };
}

void names(Report& report) {
    addLoops(report, "a short name cut / an accented long one, ns", {0.1},
             cutting("a name of an ordinary length"),
             cutting("Dur\u00E9e du d\u00E9lai entre d\u00E9but et fin"));
}

void measureAll(Report& report) {
    for (const auto topic : {numbers, blankRows, rendering, texts, orders, finding, names})
        topic(report);
}

}  // namespace

int main(int argc, char** argv) { return bench::run(argc, argv, measureAll); }
