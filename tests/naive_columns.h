#pragma once

#include <regex.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <iomanip>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "tests/provider_fixture.h"

// A second implementation of row layout, conversion and column loading, as simple as possible: full grids, and every
// query walks them. The only part of the library that it uses is the formats, which have tests of their own. Its
// operations have the names of the provider's, so that one call can be made to both and the results compared.
namespace dp::naive {

using Cell = ExternalDataRecordCell;
using Column = std::vector<std::optional<Cell>>;  // by row

constexpr unsigned kUnset = 0xFFFFFFFF;

inline std::string trimmed(const std::string& text) {
    const char* const space = " \t\n\v\f\r";
    const std::size_t first = text.find_first_not_of(space);
    return first == text.npos ? "" : text.substr(first, text.find_last_not_of(space) + 1 - first);
}
inline bool isControl(char byte) { return (byte >= 0 && byte < 0x20) || byte == 0x7F; }
inline std::string cleaned(const std::string& text) {
    std::string kept;
    for (const char byte : trimmed(text))
        if (!isControl(byte) && !(byte == ' ' && kept.ends_with(' '))) kept += byte;
    return kept;
}

// The number in a text, by a regular expression and strtod.
inline std::optional<double> numberIn(std::string text, char decimal) {
    static const regex_t form = [] {
        regex_t made;
        const char* const pattern = "^([+-]?[0-9]+([.][0-9]*)?|-?[.][0-9]+)(E[+-]?[0-9]+)?$";
        EXPECT_EQ(regcomp(&made, pattern, REG_EXTENDED | REG_NOSUB), 0);
        return made;
    }();
    text = trimmed(text);
    if (!text.empty() && text.front() == '(' && text.back() == ')') text = "-" + text.substr(1, text.size() - 2);
    for (char& c : text) {
        if (c != decimal && (c == '.' || c == '\0')) return std::nullopt;
        c = c == decimal ? '.' : c == 'D' || c == 'd' || c == 'e' ? 'E' : c;
    }
    if (regexec(&form, text.c_str(), 0, nullptr, 0) != 0) return std::nullopt;
    const double value = std::strtod(text.c_str(), nullptr);
    return std::isfinite(value) ? std::optional(value == 0 ? 0.0 : value) : std::nullopt;
}

// The first `count` characters of a text, all for 0. The text's only combining marks are U+0300 to U+033F.
inline std::string firstCharacters(const std::string& text, unsigned count) {
    const auto joins = [&](std::size_t at) {
        const auto byte = static_cast<unsigned char>(text[at]);
        return (byte & 0xC0) == 0x80 || byte == 0xCC || (byte == '\n' && text[at - 1] == '\r');
    };
    std::size_t end = count == 0 ? text.size() : 0;
    for (; count > 0 && end < text.size(); --count)
        for (++end; end < text.size() && joins(end);) ++end;
    return text.substr(0, end);
}
inline std::string variableName(const std::string& text, unsigned maximumLength) {
    std::string name = firstCharacters(text, maximumLength % 0x10000);
    std::replace(name.begin(), name.end(), '\n', ' ');
    name = trimmed(name);
    for (std::size_t i = 0; i < name.size(); ++i) {
        const bool star = i == 0 && name[i] == '*';
        if (star || name[i] == '\'' || name[i] == '#' || isControl(name[i])) name[i] = '_';
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
    std::vector<Column> columns;  // by column; one without rows counts as not stored
};

class Provider {
  public:
    std::vector<Sheet> sheets;
    std::string missingText, missingTextTo, alpha, missingShown = "*", trueText = "TRUE", falseText = "FALSE";
    double none = 1.23456e30, least = -1.001e18, most = 1.001e18, from = 1.23456e30, to = 1.23456e30;
    int textLength = 80;
    bool clean = false, helped = false;
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
        return cut(textOf(*column[rows.variableNameRow]));
    }
    std::string cut(const std::string& text) const { return text.substr(0, static_cast<unsigned>(textLength)); }
    std::string textOf(const Cell& cell) const {
        std::ostringstream text;
        if (cell.type == CELL_INTEGER) text << std::setw(12) << cell.intValue;
        if (cell.type == CELL_BOOLEAN) text << (cell.boolValue ? trueText : falseText);
        if (cell.type == CELL_TEXT) text << cell.textValue;
        if (cell.type == CELL_NUMBER || cell.type == CELL_DATETIME) text << shown(cell);
        return clean ? cleaned(text.str()) : text.str();
    }
    std::string shown(const Cell& cell) const {
        if (cell.numValue == none) return missingShown;
        const std::unique_ptr<IVariableFormat> format = formatOfStyle(cell.formatIndex);
        const auto* dates = dynamic_cast<IDateTimeVariableFormat*>(format.get());
        if (!dates || !helped || cell.type != CELL_DATETIME)
            return std::unique_ptr<IString>(format->FormatValue(cell.numValue, false))->database_str();
        return HandHelper::shown(dates->GetFormatString()->database_str(), cell.numValue);
    }
    // No value for content that is not a number; the missing value for a cell without content.
    std::optional<double> numberOf(const Cell& cell, bool asDateTime, const std::string& pattern) const {
        const bool isDate = cell.type == CELL_DATETIME;
        if (cell.type == CELL_INTEGER) return cell.intValue;
        if (cell.type == CELL_BOOLEAN) return cell.boolValue;
        if (cell.type == CELL_TEXT && asDateTime)
            return helped ? HandHelper::dateIn(pattern, cell.textValue) : std::nullopt;
        if (cell.type == CELL_TEXT) return numberIn(cell.textValue, '.');
        if (cell.type != CELL_NUMBER && !isDate) return none;
        const bool refused = asDateTime && helped && !HandHelper::isValid(cell.numValue);
        return refused || (isDate && convert) ? std::nullopt : std::optional(cell.numValue);
    }
    double realOf(const Cell& cell, bool asDateTime, const std::string& pattern, int& converted) const {
        const std::optional<double> number = numberOf(cell, asDateTime, pattern);
        double value = number.value_or(none);
        if (alpha.empty() ? value == from : cell.textValue == alpha) value = to;
        const bool within = value >= least && value <= most;
        if (!number || !within) ++converted;
        return within ? value : none;
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
    // Passes each cell whose slot is below `rows` to `store`, and the slots of rows without a cell between them to
    // `fill`. Returns whether there was any cell.
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
        const bool dateWanted = wanted == IVariable::BasicDataType::DateTime;
        facts.values.assign(rowCount(key, column), none);
        facts.missing = static_cast<int>(facts.values.size());
        std::unique_ptr<IVariableFormat> format;
        const auto fill = [&](unsigned slot) {
            if (from == none && alpha.empty()) facts.values[slot] = to;
        };
        const auto store = [&](const Cell& cell, unsigned slot) {
            const auto* dates = dynamic_cast<IDateTimeVariableFormat*>(format.get());
            const std::string pattern = dates ? dates->GetFormatString()->database_str() : "";
            double& value = facts.values[slot];
            value = previewing && slot >= 101
                        ? 1.23456e30
                        : realOf(cell, dateWanted || facts.formatType == 1, pattern, facts.converted);
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
            std::string value = previewing && slot > 100 ? "" : textOf(cell);
            if (value.find_first_not_of(' ') == std::string::npos) value.clear();
            if (value == missingText) value = missingTextTo;
            value = cut(value);
            if (!value.empty()) --facts.missing;
            longest = std::max(longest, value.size());
            facts.texts[slot] = value;
        };
        if (!walk(key, column, static_cast<unsigned>(facts.texts.size()), fill, store))
            facts.texts.clear(), facts.missing = 0;
        facts.format = "text " + std::to_string(longest);
    }

    std::map<unsigned, unsigned> lastRows_;
    std::map<unsigned, std::set<unsigned>> blankRows_;
};

}  // namespace dp::naive
