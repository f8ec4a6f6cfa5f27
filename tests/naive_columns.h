#pragma once

#include <algorithm>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "store/text_cleaning.h"
#include "tests/provider_fixture.h"

// The layout and the loading of columns in the plainest form: full grids, every question answered
// by walking them. It has the host's operations by their names, so that one call serves both it and
// the provider that it judges.
namespace dp::naive {

using Cell = ExternalDataRecordCell;
using Column = std::vector<std::optional<Cell>>;  // by row

constexpr unsigned kUnset = 0xFFFFFFFF;

inline std::string variableName(std::string name, unsigned maximumLength) {
    truncateToCharLength(name, static_cast<unsigned short>(maximumLength));
    std::replace(name.begin(), name.end(), '\n', ' ');
    trim(name);
    for (std::size_t i = 0; i < name.size(); ++i) {
        const auto byte = static_cast<unsigned char>(name[i]);
        const bool star = i == 0 && byte == '*';
        if (star || byte == '\'' || byte == '#' || byte < 0x20 || byte == 0x7F) name[i] = '_';
    }
    return name;
}

inline bool hasCell(const Column& column, std::size_t row) { return row < column.size() && column[row].has_value(); }
inline std::optional<unsigned> lastRowOf(const Column& column, unsigned bound = kUnset) {
    std::optional<unsigned> last;
    for (unsigned row = 0; row < column.size() && row <= bound; ++row)
        if (column[row]) last = row;
    return last;
}
inline const Cell* firstAtOrAfter(const Column& column, unsigned row) {
    for (std::size_t r = row; r < column.size(); ++r)
        if (column[r]) return &*column[r];
    return nullptr;
}

struct Sheet {
    unsigned key;
    std::vector<Column> columns;  // by column; one without rows is not stored
};

class Provider {
  public:
    explicit Provider(const HandFilledProvider& library) : library_(library) {}

    std::vector<Sheet> sheets;
    std::string missingText, missingTextTo, alpha;
    double from = 1.23456e30, to = 1.23456e30;
    bool convert = false, previewing = false, ignoreBlank = false, pad = false;
    unsigned nameLength = kUnset;
    EVariableNameRowSetting defaultSetting{kUnset};
    std::map<unsigned, SheetReadOptions> options;
    std::map<unsigned, ColumnOptions> columnOptions;

    void SetReadOptionIgnoreBlankRows(bool on) {
        ignoreBlank = on;
        if (!on) blankRows_.clear();
        if (on)
            for (const Sheet& sheet : sheets) analyse(sheet.key, false);
    }
    void SetReadOptionPadColumnsWithMissingValues(bool on) {
        pad = on;
        if (on)
            for (const Sheet& sheet : sheets) findLastRow(sheet.key);
    }
    void SetReadOptionDataRowPositions(unsigned key, EVariableNameRowSetting setting, unsigned nameRow,
                                       unsigned firstRow) {
        SheetReadOptions& rows = options[key];
        rows.rowsOneBased = true;
        rows.variableNameRowSetting = setting;
        rows.variableNameRow = setting == VNR_GIVEN && nameRow ? nameRow : kUnset;
        rows.firstDataRow = firstRow ? firstRow : kUnset;
        calculateRows(key);
    }
    void SetReadOptionExclude(unsigned key, bool on) {
        options[key].exclude = on;
        analyse(key, true);
    }
    std::vector<int> worksheetKeys() {
        std::vector<int> keys;
        for (const Sheet& sheet : sheets) {
            if (options.count(sheet.key) && options[sheet.key].exclude) continue;
            analyse(sheet.key, true);
            keys.push_back(static_cast<int>(sheet.key));
        }
        return keys;
    }
    ColumnFacts find(int key, ColumnType requested, bool ignoreExclusion) {
        int next = 1;
        for (const Sheet& sheet : sheets)
            for (unsigned column = 0; column < sheet.columns.size(); ++column)
                if (!sheet.columns[column].empty() && next++ == key)
                    return load(sheet, column, requested, ignoreExclusion);
        return {};
    }

  private:
    SheetReadOptions& optionsByDefault(unsigned key) {
        if (!options.count(key) && defaultSetting != EVariableNameRowSetting{kUnset})
            options[key].variableNameRowSetting = defaultSetting;
        return options[key];
    }
    const Sheet* sheetOf(unsigned key) const {
        for (const Sheet& sheet : sheets)
            if (sheet.key == key) return &sheet;
        return nullptr;
    }
    bool excludes(unsigned key, unsigned column) {
        return columnOptions[key].count(column + 1) && columnOptions[key][column + 1].exclude;
    }
    void analyse(unsigned key, bool rowsToo) {
        if (rowsToo) calculateRows(key);
        findLastRow(key);
        findBlankRows(key);
    }
    void calculateRows(unsigned key) {
        SheetReadOptions& rows = optionsByDefault(key);
        if (rows.exclude) return;
        const unsigned less = rows.rowsOneBased ? 1 : 0;
        rows.rowsOneBased = false;
        unsigned& names = rows.variableNameRow;
        unsigned& first = rows.firstDataRow;
        if (names != kUnset) names -= less;
        if (first != kUnset) first -= less;
        EVariableNameRowSetting& setting = rows.variableNameRowSetting;
        if (setting == VNR_INFER) {
            const Sheet* sheet = sheetOf(key);
            if (!sheet) return;
            setting = rowOfNames(*sheet) ? VNR_GIVEN : VNR_NONE;
            if (setting == VNR_GIVEN) names = 0;
        }
        if (setting == VNR_GIVEN && names == kUnset) names = 0;
        if (first == kUnset) first = setting == VNR_GIVEN ? names + 1 : 0;
    }
    static bool rowOfNames(const Sheet& sheet) {
        bool names = false;
        for (const Column& column : sheet.columns) {
            if (!hasCell(column, 0)) continue;
            const unsigned type = column[0]->type;
            if (type == CELL_INTEGER || type == CELL_NUMBER || type == CELL_DATETIME) return false;
            names = names || type == CELL_TEXT;
        }
        return names;
    }
    bool hidden(unsigned key) { return options.count(key) && options[key].exclude; }
    void findLastRow(unsigned key) {
        const Sheet* sheet = sheetOf(key);
        if (!sheet || !(ignoreBlank || pad) || lastRows_.count(key) || hidden(key)) return;
        unsigned last = 0;
        for (const Column& column : sheet->columns) last = std::max(last, lastRowOf(column).value_or(0));
        lastRows_[key] = last;
    }
    void findBlankRows(unsigned key) {
        const Sheet* sheet = sheetOf(key);
        if (!sheet || !ignoreBlank || blankRows_.count(key) || hidden(key)) return;
        std::set<unsigned>& blank = blankRows_[key];
        for (unsigned row = 0; row <= lastRows_[key]; ++row) {
            bool any = false;
            for (unsigned c = 0; c < sheet->columns.size(); ++c)
                any = any || (hasCell(sheet->columns[c], row) && !excludes(key, c));
            if (!any) blank.insert(row);
        }
    }
    unsigned blanks(unsigned key, unsigned begin, unsigned end) {
        unsigned count = 0;
        if (ignoreBlank && blankRows_.count(key))
            for (const unsigned row : blankRows_[key]) count += row >= begin && row < end ? 1U : 0U;
        return count;
    }

    std::string nameInSheet(const SheetReadOptions& rows, const Column& column) {
        if (rows.variableNameRowSetting == VNR_NONE || !hasCell(column, rows.variableNameRow)) return "";
        return library_.ConvertCellToString(*column[rows.variableNameRow], true);
    }
    unsigned rowCount(unsigned key, const Column& column) {
        const unsigned first = options[key].firstDataRow;
        const unsigned limit = options[key].dataRowCount;
        std::optional<unsigned> last = lastRowOf(column);
        if (!pad && static_cast<double>(first) + limit <= 4294967295.0) last = lastRowOf(column, first + limit - 1);
        if (!last) return 0;
        if (pad && (firstAtOrAfter(column, first) || !nameInSheet(options[key], column).empty())) last = lastRows_[key];
        const unsigned n = *last + 1 - first > 0x7FFFFFFF ? 0 : *last + 1 - first;
        const unsigned count = std::min(n, limit);
        return n ? count - blanks(key, first, first + count) : count;
    }
    // Hands each cell that gets a slot below `rows` to `store`, and the slots of the rows without
    // cell in between to `fill`. Answers whether there was any cell.
    template <typename Fill, typename Store>
    bool walk(unsigned key, const Column& column, unsigned rows, const Fill& fill, const Store& store) {
        const unsigned first = options[key].firstDataRow;
        unsigned index = 0;
        unsigned expected = first;
        for (std::size_t r = first; r < column.size() && index < rows; ++r) {
            if (!column[r]) continue;
            const auto row = static_cast<unsigned>(r);
            const unsigned gap = row - expected - blanks(key, expected, row);
            const unsigned before = blanks(key, first, std::max(expected, first + 1) - 1);
            for (unsigned slot = expected - first - before, i = 0; i < gap; ++i, ++slot)
                if (slot < rows) fill(slot);
            index += gap;
            if (index >= rows) break;
            expected = row + 1;
            store(*column[r], index++);
        }
        return expected != first;
    }

    ColumnFacts load(const Sheet& sheet, unsigned index, ColumnType requested, bool ignoreExclusion) {
        using Basic = IVariable::BasicDataType;
        ColumnFacts facts;
        const Column& column = sheet.columns[index];
        const Cell* firstData = firstAtOrAfter(column, options[sheet.key].firstDataRow);
        facts.name = nameInSheet(options[sheet.key], column);
        if (!firstData)
            facts.formatType = requested == ColumnType::Text ? 2 : 0;
        else
            facts.formatType = firstData->type == CELL_TEXT ? 2 : (isDateStyle(firstData->formatIndex) ? 1 : 0);
        bool texts = requested == ColumnType::Text;
        if (requested == ColumnType::Automatic) texts = facts.formatType == 2 || (facts.formatType == 1 && convert);
        facts.position = static_cast<int>(index) + 1;
        ColumnReadOptions option;
        if (columnOptions[sheet.key].count(index + 1)) option = columnOptions[sheet.key][index + 1];
        if (option.columnType != Basic::NotSet) {
            texts = option.columnType == Basic::Text;
            facts.formatType = texts ? 2 : 0;
        }
        if (option.destinationId != kUnset) facts.position = static_cast<int>(option.destinationId);
        if (!option.name.empty()) facts.name = option.name;
        facts.found = !option.exclude || ignoreExclusion;
        facts.name = facts.found ? variableName(facts.name, nameLength) : "";
        if (!facts.found)
            facts.position = 0;
        else if (texts)
            loadTexts(sheet.key, column, facts);
        else
            loadNumbers(sheet.key, column, option.columnType, facts);
        return facts;
    }
    void loadNumbers(unsigned key, const Column& column, IVariable::BasicDataType wanted, ColumnFacts& facts) {
        const double none = ExcelDataProviderBase::_missingValue;
        const bool dateWanted = wanted == IVariable::BasicDataType::DateTime;
        facts.values.assign(rowCount(key, column), none);
        facts.missing = static_cast<int>(facts.values.size());
        std::unique_ptr<IVariableFormat> format;
        const auto fill = [&](unsigned slot) {
            if (from == none && alpha.empty()) facts.values[slot] = to;
        };
        const auto store = [&](const Cell& cell, unsigned slot) {
            const auto* dates = dynamic_cast<IDateTimeVariableFormat*>(format.get());
            bool converted = false;
            double& value = facts.values[slot];
            value = previewing && slot >= 101
                        ? 1.23456e30
                        : library_.ConvertCellToReal(cell, dateWanted || facts.formatType == 1,
                                                     dates ? dates->GetFormatString() : nullptr, converted);
            facts.converted += converted ? 1 : 0;
            if (value == none) return;
            --facts.missing;
            if (!format) format = inferred(cell, wanted);
        };
        const bool handled = walk(key, column, static_cast<unsigned>(facts.values.size()), fill, store);
        if (!format) format = automaticFormat(dateWanted);
        const bool dates = format->GetType() == IVariableFormat::FormatType::DateTime;
        facts.dataType = dateWanted || dates ? 2 : 0;
        facts.format = describe(*format);
        if (facts.name.empty() && !handled) facts.values.clear(), facts.missing = 0;
    }
    static std::unique_ptr<IVariableFormat> automaticFormat(bool dateTime) {
        if (!dateTime) return formatOfStyle(kNoStyle);
        auto format = std::make_unique<DateTimeVariableFormat>();
        format->autoFormat = true;
        return format;
    }
    static std::unique_ptr<IVariableFormat> inferred(const Cell& cell, IVariable::BasicDataType wanted) {
        using Basic = IVariable::BasicDataType;
        using Type = IVariableFormat::FormatType;
        std::unique_ptr<IVariableFormat> format = formatOfStyle(cell.formatIndex);
        const bool dateWanted = wanted == Basic::DateTime;
        if (!dateWanted && wanted != Basic::Numeric) return format;
        const bool styled = dateWanted ? cell.formatIndex != -1 : cell.formatIndex >= 0;
        if (styled && format->GetType() == (dateWanted ? Type::DateTime : Type::Numeric)) return format;
        return automaticFormat(dateWanted);
    }
    void loadTexts(unsigned key, const Column& column, ColumnFacts& facts) {
        facts.dataType = 4;
        facts.texts.resize(rowCount(key, column));
        facts.missing = static_cast<int>(facts.texts.size());
        std::size_t longest = 1;
        const auto fill = [&](unsigned slot) {
            if (missingText.empty()) facts.texts[slot] = missingTextTo;
        };
        const auto store = [&](const Cell& cell, unsigned slot) {
            std::string value = previewing && slot > 100 ? "" : library_.ConvertCellToString(cell, false);
            if (value.find_first_not_of(' ') == std::string::npos) value.clear();
            if (value == missingText) value = missingTextTo;
            value = value.substr(0, static_cast<unsigned>(ExcelDataProviderBase::_maxTextLength));
            if (!value.empty()) --facts.missing;
            longest = std::max(longest, value.size());
            facts.texts[slot] = value;
        };
        if (!walk(key, column, static_cast<unsigned>(facts.texts.size()), fill, store))
            facts.texts.clear(), facts.missing = 0;
        facts.format = "text " + std::to_string(longest);
    }

    const HandFilledProvider& library_;  // for the conversion of single cells alone
    std::map<unsigned, unsigned> lastRows_;
    std::map<unsigned, std::set<unsigned>> blankRows_;
};

}  // namespace dp::naive
