#pragma once

#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/reference.h"
#include "testkit/process_settings.h"
#include "testkit/providers.h"

namespace dp {

// The styles of hand-filled cells. Two are contradictory: one has a date-time format but does not count as date-time,
// the other the other way round.
enum HandStyle { kNumberAsDate = -2, kNoStyle, kFixed2, kPercent, kDate, kTime, kDateAsNumber };

inline bool isDateStyle(int style) { return style == kDate || style == kTime || style == kDateAsNumber; }

inline std::unique_ptr<IVariableFormat> formatOfStyle(int style) {
    if (style == kPercent) return std::make_unique<PercentageVariableFormat>();
    if (style == kTime) return std::make_unique<DateTimeVariableFormat>(std::string("H:mm"));
    if (style == kDate || style == kNumberAsDate)
        return std::make_unique<DateTimeVariableFormat>(std::string("M/d/yyyy"));
    auto format = std::make_unique<NumericVariableFormat>();
    format->autoFormat = style == kNoStyle;
    format->decimalPlaces = style == kFixed2 ? 2 : 0;
    return format;
}

// A host's date-time helper: it reads texts "d<number>", adds a thousandth for each byte of a known pattern, and
// rejects values below 0 and from 100000 on.
class HandHelper : public DateTimeVariableFormat {
  public:
    static std::optional<double> dateIn(const std::string& pattern, const std::string& text) {
        if (!text.starts_with("d")) return std::nullopt;
        return std::stod("0" + text.substr(1)) + static_cast<double>(pattern.size()) / 1000;
    }
    static bool isValid(double value) { return value >= 0 && value < 100000; }
    static std::string shown(const std::string& pattern, double value) {
        return "by helper " + pattern + " " + std::to_string(value);
    }

    bool ConvertToDatetime(const IString* format, IString* text, double& value) const override {
        const std::optional<double> date = dateIn(format ? format->database_str() : "", text->database_str());
        if (date) value = *date;
        return date.has_value();
    }
    bool ValidVextralTime(double value) const override { return isValid(value); }
    void SetDateTimeParameters(const IDateTimeVariableFormat* other) override {
        taken_ = other->GetFormatString()->database_str();
    }
    IString* FormatValue(double value, bool) const override { return new String(shown(taken_, value)); }

  private:
    std::string taken_;
};

// A provider with the formats of these styles.
class HandFilledProvider : public testkit::FilingProvider {
  public:
    IVariableFormat* CreateVextralNumericFormat(const ExternalDataRecordCell& cell) const override {
        ++formatsMade;
        return formatOfStyle(cell.formatIndex).release();
    }
    bool IsDateTimeFormatType(const ExternalDataRecordCell& cell) const override {
        return isDateStyle(cell.formatIndex);
    }

    using ExcelDataProviderBase::_blankRows;
    using ExcelDataProviderBase::_cells;
    mutable int formatsMade = 0;
};

// A cell by its code: "'text", "i12" integer, "?1" Boolean, "@3" date-time with the date style, otherwise a number. A
// last letter names another style: "2f" fixed, "2%", "@3t" time, "@3n" contradictory.
inline ExternalDataRecordCell cellOf(const std::string& code) {
    ExternalDataRecordCell cell;
    const std::string kinds = "'i?@";
    const std::size_t kind = kinds.find(code.at(0));
    if (kind == 0) {
        cell.type = CELL_TEXT;
        cell.textValue = code.substr(1);
        return cell;
    }
    const double value = std::stod(code.substr(kind < kinds.size() ? 1 : 0));
    constexpr ExternalCellType types[] = {CELL_TEXT, CELL_INTEGER, CELL_BOOLEAN, CELL_DATETIME};
    cell.type = kind < kinds.size() ? types[kind] : CELL_NUMBER;
    if (kind == 1) cell.intValue = static_cast<int>(value);
    if (kind == 2) cell.boolValue = static_cast<int>(value);
    if (kind >= 3) cell.numValue = value;
    const std::string styles = "f%?tn";  // in the order of HandStyle
    const std::size_t style = styles.find(code.back());
    cell.formatIndex = style < styles.size() ? static_cast<int>(style) : kind == 3 ? kDate : kNoStyle;
    return cell;
}

// A format in words.
inline std::string describe(const IVariableFormat& format) {
    const std::string automatic = format.GetAuto() ? "auto " : "";
    if (const auto* text = dynamic_cast<const ITextVariableFormat*>(&format))
        return "text " + std::to_string(text->GetCharacterCount());
    if (const auto* dates = dynamic_cast<const IDateTimeVariableFormat*>(&format))
        return automatic + "date-time " + dates->GetFormatString()->database_str();
    const auto& numeric = dynamic_cast<const INumericVariableFormat&>(format);
    int places = 0;
    numeric.GetDecimalPlaces(&places, nullptr);
    const int subtype = static_cast<int>(numeric.GetNumericSubtype());
    return automatic + "numeric " + std::to_string(subtype) + "." + std::to_string(places);
}

// What a host sees of a column.
struct ColumnFacts {
    bool found = false;
    int formatType = -1;
    int dataType = -1;
    int missing = 0;
    int converted = 0;
    int position = 0;
    std::string name;
    std::string format;
    std::vector<double> values;
    std::vector<std::string> texts;

    // The values alone, missing ones as "*".
    std::string rows() const {
        std::ostringstream out;
        out.precision(17);
        for (const double value : values) value == 1.23456e30 ? out << " *" : out << ' ' << value;
        for (const std::string& value : texts) out << " '" << value << '\'';
        return out.str().substr(out.str().empty() ? 0 : 1);
    }
    std::string all() const {
        std::ostringstream out;
        out << "found " << found << ", format type " << formatType << ", data type " << dataType << ", missing "
            << missing << ", converted " << converted << ", position " << position << ", name '" << name << "', format "
            << format << ": " << rows();
        return out.str();
    }
};

// Asks for a column, notes what it shows and releases it.
inline ColumnFacts factsOf(const ExcelDataProviderBase& provider, int key, ColumnType requested = ColumnType::Automatic,
                           bool ignoreExclusion = false) {
    ColumnFacts facts;
    IColumn* column = reinterpret_cast<IColumn*>(&facts);  // to be set to null
    IVariableFormat::FormatType type{-1};
    facts.found = provider.FindColumn(key, &column, requested, &type, ignoreExclusion);
    facts.formatType = static_cast<int>(type);
    EXPECT_EQ(column != nullptr, facts.found);
    if (!facts.found || !column) return facts;
    const Reference<IColumn> held(column);
    EXPECT_EQ(std::pair(column->GetPrimeKey(), column->GetVariableBodyPrimeKey()), std::pair(key, key));
    EXPECT_TRUE(column->IsFormatDirty() && !column->UseDefaultVariableBody());
    facts.dataType = column->GetDataType();
    facts.missing = column->GetMissingCount();
    facts.position = column->GetPosition();
    facts.name = column->GetName()->database_str();
    facts.format = describe(*column->GetFormat());
    if (const auto* numeric = dynamic_cast<INumericColumn*>(column)) {
        facts.converted = numeric->GetConvertedMissingCount();
        facts.values.assign(numeric->GetValues(), numeric->GetValues() + column->GetRowCount());
    } else {
        const auto& texts = *dynamic_cast<ITextColumn&>(*column).GetTextValues();
        EXPECT_EQ(texts.Count(), static_cast<unsigned long>(column->GetRowCount()));
        for (unsigned long i = 0; i < texts.Count(); ++i) facts.texts.emplace_back(texts.Item(i).database_str());
    }
    return facts;
}

class ProviderTest : public testing::Test {
  protected:
    testkit::KeptSettings settings;
    HandFilledProvider provider;
};

}  // namespace dp
