#include "tools/options/settings.h"

#include <algorithm>
#include <memory>
#include <set>

#include <dpxlsx/model/host/i_column.h>
#include <dpxlsx/model/host/i_finders.h>
#include <dpxlsx/model/host/i_string.h>
#include <dpxlsx/model/host/i_worksheet.h>
#include <dpxlsx/model/host/reference.h>

#include "tools/host/date_time_helper.h"
#include "tools/options/column_reference.h"

namespace dp::tool {

namespace {

double numberOr(const NumberOrMissing& number, const ReadSettings& settings) {
    return number.value_or(settings.missing.value_or(kDefaultMissing));
}

void applyMissing(IDataProvider& provider, const ReadSettings& settings) {
    if (settings.missing) provider.SetMissingValue(*settings.missing);
    if (settings.missingDisplay) {
        provider.SetMissingValueTextRepresentation(settings.missingDisplay->c_str());
    }
    if (settings.missingText) {
        const auto& [from, to] = *settings.missingText;
        provider.SetMissingText(from.c_str(), to.c_str());
    }
    if (settings.missingWord) {
        const auto& [from, to] = *settings.missingWord;
        provider.SetAlphaMissingNumeric(from.c_str(), numberOr(to, settings));
    }
}

void applyTexts(IDataProvider& provider, const ReadSettings& settings) {
    if (settings.maxText) provider.SetMaximumTextLength(*settings.maxText);
    if (settings.maxName) provider.SetMaxVariableNameLength(*settings.maxName);
    if (settings.trueText) provider.SetBooleanTrueValue(settings.trueText->c_str());
    if (settings.falseText) provider.SetBooleanFalseValue(settings.falseText->c_str());
    provider.SetReadOptionCleanTextValues(settings.cleanText);
    provider.SetReadOptionCleanWorksheetNames(settings.cleanSheetNames);
    provider.SetReadOptionConvertDateTimeToText(settings.datesAsText);
}

bool isNamed(const SheetEntry& sheet, const std::string& name) {
    return sheet.title == name || std::to_string(sheet.key) == name;
}

// The key of the worksheet with this name, else of the one with this key.
int keyOf(const std::vector<SheetEntry>& sheets, const std::string& name) {
    const auto titled = [&](const SheetEntry& sheet) { return sheet.title == name; };
    auto found = std::find_if(sheets.begin(), sheets.end(), titled);
    if (found == sheets.end()) {
        found = std::find_if(sheets.begin(), sheets.end(),
                             [&](const SheetEntry& sheet) { return isNamed(sheet, name); });
    }
    if (found == sheets.end()) throw UnknownWorksheet(name, worksheetsText(sheets));
    return found->key;
}

std::set<int> keysOf(const std::vector<SheetEntry>& sheets, const std::vector<std::string>& names) {
    std::set<int> keys;
    for (const std::string& name : names) keys.insert(keyOf(sheets, name));
    return keys;
}

// Whether any column of the worksheet has a variable name.
bool hasNames(IDataProvider& provider, int sheet) {
    IVariableFinder& finder = *provider.GetVariableFinder();
    const IReadOnlyCollection<int>& keys = *finder.GetColumnPrimeKeys(sheet);
    for (unsigned long i = 0; i < keys.Count(); ++i) {
        IColumn* found = nullptr;
        if (!finder.FindColumn(keys.Item(i), &found, true)) continue;
        const Reference<IColumn> column(found);
        if (*column->GetName()->database_str() != '\0') return true;
    }
    return false;
}

// The row from which the library takes the names. The library does not say what it inferred, but
// columns have names only if it found a row of them.
unsigned nameRowOf(IDataProvider& provider, const ReadSettings& settings, int sheet) {
    switch (settings.names.value_or(VNR_GIVEN)) {
        case VNR_NONE:
            return 0;
        case VNR_GIVEN:
            return settings.nameRow == 0 ? 1 : settings.nameRow;
        case VNR_INFER:
            break;
    }
    provider.SetPreviewing(true);  // less to convert
    const bool found = hasNames(provider, sheet);
    provider.SetPreviewing(settings.preview);
    return found ? 1 : 0;
}

void applyRows(IDataProvider& provider, const ReadSettings& settings, int sheet) {
    const auto key = static_cast<unsigned>(sheet);
    provider.SetReadOptionDataRowPositions(key, settings.names.value_or(VNR_GIVEN),
                                           settings.nameRow, settings.firstRow);
    if (settings.rows) provider.SetReadOptionDataRowCount(key, *settings.rows);
}

// The numbers of a worksheet's columns, by key. To be called before any option gives columns other
// positions.
std::map<int, unsigned> columnsOf(IDataProvider& provider, int sheet) {
    std::map<int, unsigned> numbers;
    const IVariableFinder& finder = *provider.GetVariableFinder();
    const IReadOnlyCollection<int>& keys = *finder.GetColumnPrimeKeys(sheet);
    for (unsigned long i = 0; i < keys.Count(); ++i) {
        IColumn* found = nullptr;
        if (!finder.FindColumn(keys.Item(i), &found, true)) continue;
        const Reference<IColumn> column(found);
        numbers[keys.Item(i)] = static_cast<unsigned>(column->GetPosition());
    }
    return numbers;
}

class ColumnOptions {
  public:
    ColumnOptions(IDataProvider& provider, const std::vector<SheetEntry>& all,
                  const ReadSettings& settings, ReadPlan& plan)
        : provider_(provider), all_(all), settings_(settings), plan_(plan) {}

    void apply() {
        if (!areGiven()) return;
        findColumns();
        for (const ColumnReference& excluded : settings_.excluded) {
            forEach("--exclude", excluded, [&](unsigned key, unsigned column) {
                provider_.SetReadColumnOptionExclude(key, column, true);
            });
        }
        for (const auto& [where, type] : settings_.types) {
            forEach("--type", where, [&, wanted = type](unsigned key, unsigned column) {
                provider_.SetReadColumnOptionColumnType(key, column, wanted);
            });
        }
        for (const auto& [where, name] : settings_.renamed) {
            forEach("--rename", where, [&, wanted = name](unsigned key, unsigned column) {
                provider_.SetReadColumnOptionName(key, column, wanted.c_str());
            });
        }
        for (const auto& [where, place] : settings_.positions) {
            forEach("--position", where, [&, wanted = place](unsigned key, unsigned column) {
                provider_.SetReadColumnOptionDestinationId(key, column, wanted);
            });
        }
    }

  private:
    bool areGiven() const {
        return !settings_.excluded.empty() || !settings_.types.empty() ||
               !settings_.renamed.empty() || !settings_.positions.empty();
    }

    void findColumns() {
        provider_.SetPreviewing(true);  // less to convert
        for (const SheetEntry& sheet : listSheets(provider_)) {
            std::set<unsigned>& numbers = numbers_[sheet.key];
            for (const auto& [key, number] : columnsOf(provider_, sheet.key)) {
                plan_.columnNumbers.emplace(key, number);
                numbers.insert(number);
            }
        }
        provider_.SetPreviewing(settings_.preview);
    }

    // Calls `act` for each worksheet that the reference names and that has the column. Worksheets
    // that are left out do not count.
    template <class Act>
    void forEach(const char* option, const ColumnReference& column, Act act) {
        const bool every = column.worksheet.empty();
        const int wanted = every ? 0 : keyOf(all_, column.worksheet);
        bool found = !every && numbers_.count(wanted) == 0;
        for (const auto& [key, numbers] : numbers_) {
            if ((!every && key != wanted) || numbers.count(column.column) == 0) continue;
            act(static_cast<unsigned>(key), column.column);
            found = true;
        }
        if (!found) missColumn(option, column);
    }

    void missColumn(const std::string& option, const ColumnReference& column) {
        const std::string text = "column " + columnLetters(column.column) + " with values";
        if (!column.worksheet.empty()) {
            throw Failure(kUsage, option + ": the worksheet \"" + column.worksheet + "\" has no " +
                                      text + "; leave the option out or name another column");
        }
        plan_.notes.push_back("no worksheet has a " + text + ": " + option + " does nothing");
    }

    IDataProvider& provider_;
    const std::vector<SheetEntry>& all_;
    const ReadSettings& settings_;
    ReadPlan& plan_;
    std::map<int, std::set<unsigned>> numbers_;  // of the columns, by worksheet key
};

// Excludes worksheets by the options, and returns their titles.
std::set<std::string> excludeSheets(IDataProvider& provider, const Options& options,
                                    const std::vector<SheetEntry>& sheets) {
    std::set<std::string> titles;
    const std::set<int> wanted = keysOf(sheets, options.sheets);
    const std::set<int> unwanted = keysOf(sheets, options.settings.excludedSheets);
    for (const SheetEntry& sheet : sheets) {
        const bool left =
            unwanted.count(sheet.key) != 0 || (!wanted.empty() && wanted.count(sheet.key) == 0);
        if (!left) continue;
        provider.SetReadOptionExclude(static_cast<unsigned>(sheet.key), true);
        titles.insert(sheet.title);
    }
    return titles;
}

}  // namespace

std::string worksheetsText(const std::vector<SheetEntry>& sheets) {
    constexpr size_t kMost = 10;
    if (sheets.empty()) return "it has none with values";
    std::string text;
    for (size_t i = 0; i < std::min(sheets.size(), kMost); ++i) {
        text += (i == 0 ? "it has \"" : ", \"") + sheets[i].title + "\" (" +
                std::to_string(sheets[i].key) + ")";
    }
    const size_t more = sheets.size() - std::min(sheets.size(), kMost);
    return more == 0 ? text : text + " and " + std::to_string(more) + " more";
}

std::vector<SheetEntry> listSheets(IDataProvider& provider) {
    IWorksheetFinder& finder = *provider.GetWorksheetFinder();
    const IReadOnlyCollection<int>& keys = *finder.GetWorksheetPrimeKeys();
    std::vector<SheetEntry> sheets;
    for (unsigned long i = 0; i < keys.Count(); ++i) {
        IWorksheet* found = nullptr;
        if (!finder.FindWorksheet(keys.Item(i), &found)) continue;
        const Reference<IWorksheet> sheet(found);
        sheets.push_back({keys.Item(i), sheet->GetTitle()});
    }
    return sheets;
}

void applyNumbers(IDataProvider& provider, const ReadSettings& settings) {
    if (settings.range) provider.SetNumericRange(settings.range->first, settings.range->second);
    if (!settings.missingNumber) return;
    const auto& [from, to] = *settings.missingNumber;
    provider.SetMissingNumeric(numberOr(from, settings), numberOr(to, settings));
}

void applySettings(IDataProvider& provider, const ReadSettings& settings) {
    auto helper = std::make_unique<DateTimeHelper>();
    provider.SetDateTimeVariableFormatHelper(helper.release());
    provider.SetReadOptionDefaultUseVariableNameRow(settings.names.value_or(VNR_GIVEN));
    provider.SetPreviewing(settings.preview);
    if (settings.decimal) provider.SetInputDecimal(*settings.decimal);
    applyMissing(provider, settings);
    applyNumbers(provider, settings);
    applyTexts(provider, settings);
}

ReadPlan applyReadOptions(IDataProvider& provider, const Options& options) {
    const std::vector<SheetEntry> sheets = listSheets(provider);
    ReadPlan plan;
    plan.leftOut = excludeSheets(provider, options, sheets);
    for (const SheetEntry& sheet : listSheets(provider)) {
        applyRows(provider, options.settings, sheet.key);
        plan.nameRows[sheet.key] = nameRowOf(provider, options.settings, sheet.key);
    }
    ColumnOptions(provider, sheets, options.settings, plan).apply();
    // Last, because blank rows are determined once, from the columns that are not excluded by then.
    provider.SetReadOptionPadColumnsWithMissingValues(options.settings.pad);
    provider.SetReadOptionIgnoreBlankRows(options.settings.skipBlankRows);
    return plan;
}

}  // namespace dp::tool
