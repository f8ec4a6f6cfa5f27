#include "tools/views/json_view.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include <dpxlsx/model/host/i_formula.h>
#include <dpxlsx/model/host/i_string.h>
#include <dpxlsx/model/host/i_variable_format.h>
#include <nlohmann/json.hpp>

#include "tools/host/calendar.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

using Json = nlohmann::ordered_json;

std::string dumped(const Json& json) { return json.dump(); }

// The text of the object without its closing brace, for more members to follow.
std::string opened(const Json& object) {
    std::string text = dumped(object);
    text.pop_back();
    return text;
}

Json text(const char* value) { return validUtf8(value == nullptr ? "" : value); }
Json text(const IString* value) { return text(value == nullptr ? "" : value->database_str()); }

// Whole numbers without a fraction, as people write them.
Json number(double value) {
    constexpr double kExactUpTo = 9007199254740992.0;  // 2 to the power of 53
    const bool whole = std::abs(value) < kExactUpTo && value == std::trunc(value);
    return whole ? Json(static_cast<long long>(value)) : Json(value);
}

Json layoutJson(const Layout& layout) {
    Json json;
    json["nameRow"] = layout.nameRow == 0 ? Json() : Json(layout.nameRow);
    json["firstDataRow"] = layout.firstDataRow;
    json["rows"] = layout.rows;
    json["lastUsedRow"] = layout.usedRows;
    return json;
}

Json viewJson(const IWorksheetView& view) {
    return {{"allColumns", view.GetAllColumns()},
            {"horizontalEntry", view.GetHorizontalEntry()},
            {"printGrid", view.GetPrintGrid()},
            {"printColumnNames", view.GetPrintColumnNames()},
            {"printColumnLabels", view.GetPrintColumnLabels()},
            {"printRowLabels", view.GetPrintRowLabels()},
            {"activeRow", view.GetActiveRow()},
            {"activeColumn", view.GetActiveColumn()},
            {"leftmostVisibleColumn", view.GetLeftmostVisibleColumn()},
            {"topVisibleRow", view.GetTopVisibleRow()},
            {"standardColumnWidth", number(view.GetStandardColumnWidth())},
            {"dataFontStyle", view.GetDataFontStyle()},
            {"labelFontStyle", view.GetLabelFontStyle()},
            {"dataFontPointSize", view.GetDataFontPointSize()},
            {"labelFontPointSize", view.GetLabelFontPointSize()},
            {"printJustification", view.GetPrintJustification()},
            {"dataFont", text(view.GetDataFontFaceName())},
            {"labelFont", text(view.GetLabelFontFaceName())},
            {"missingValue", text(view.GetMissingValue())}};
}

Json formulaJson(const IFormulaManager& formulas) {
    return {{"updateAutomatically", formulas.GetUpdateAutomatically()},
            {"recalculate", formulas.GetRecalculate()},
            {"statusUpdateRequired", formulas.GetStatusUpdateRequired()},
            {"listSeparator", text(formulas.GetListSeparator())},
            {"decimalSymbol", text(formulas.GetDecimalSymbol())},
            {"nodes", formulas.GetFormulaNodeCount()}};
}

void addNumericFormat(Json& json, const INumericVariableFormat& format) {
    int decimals = 0;
    int significant = 0;
    double low = 0;
    double high = 0;
    format.GetDecimalPlaces(&decimals, &significant);
    format.GetValueRange(&low, &high);
    json["subtype"] = static_cast<int>(format.GetNumericSubtype());
    json["decimalPlaces"] = decimals;
    json["significantDigits"] = significant;
    json["range"] = {number(low), number(high)};
    json["showsFullPrecision"] = format.ShowFullPrecision();
    if (format.GetNumericSubtype() == NumericSubtype::Percentage) {
        json["percentDecimalPlaces"] =
            static_cast<const IPercentageVariableFormat&>(format).GetDecimalPlaces();
    }
}

void addDateTimeFormat(Json& json, const IDateTimeVariableFormat& format) {
    unsigned parameters[4] = {0, 0, 0, 0};
    format.GetDateTimeParameters(&parameters[0], &parameters[1], &parameters[2], &parameters[3]);
    json["pattern"] = text(format.GetFormatString());
    json["parameters"] = parameters;
}

Json formatJson(const Column& column) {
    const IVariableFormat* format = column.host().GetFormat();
    if (format == nullptr) return {};
    Json json = {{"words", validUtf8(column.formatText())},
                 {"type", static_cast<int>(format->GetType())},
                 {"automatic", format->GetAuto()}};
    switch (format->GetType()) {
        case IVariableFormat::FormatType::Numeric:
            addNumericFormat(json, static_cast<const INumericVariableFormat&>(*format));
            break;
        case IVariableFormat::FormatType::DateTime:
            addDateTimeFormat(json, static_cast<const IDateTimeVariableFormat&>(*format));
            break;
        case IVariableFormat::FormatType::Text:
            json["longest"] = static_cast<const ITextVariableFormat&>(*format).GetCharacterCount();
            break;
    }
    return json;
}

Json columnHead(const Column& column) {
    const IColumn& host = column.host();
    const IColumnView& view = *host.GetView();
    return {{"key", host.GetPrimeKey()},
            {"position", host.GetPosition()},
            {"name", validUtf8(column.name())},
            {"kind", kindName(column.kind())},
            {"rows", host.GetRowCount()},
            {"missing", host.GetMissingCount()},
            {"convertedMissing", column.convertedMissing()},
            {"format", formatJson(column)},
            {"formatDirty", host.IsFormatDirty()},
            {"description", text(host.GetDescription())},
            {"dataType", host.GetDataType()},
            {"variableType", host.GetType()},
            {"variableBodyKey", host.GetVariableBodyPrimeKey()},
            {"originalVariableKey", host.GetOriginalVariablePrimeKey()},
            {"usesDefaultVariableBody", host.UseDefaultVariableBody()},
            {"worksheetId", host.GetWorksheetId()},
            {"attached", host.Attached()},
            {"isCopy", host.IsCopy()},
            {"lastModified", host.GetLastModified()},
            {"view",
             {{"autoWiden", view.GetAutoWiden()},
              {"widthSet", view.GetWidthSet()},
              {"hidden", view.GetHidden()},
              {"width", number(view.GetWidth())}}}};
}

Json orderingJson(const Column& column) {
    const auto& texts = static_cast<const ITextColumn&>(column.host());
    const IColumnOrdering& ordering = *texts.GetOrdering();
    const IReadOnlyCollection<IString&>& ordered = *ordering.GetOrderedTextValues();
    Json list = Json::array();
    for (unsigned long i = 0; i < ordered.Count(); ++i) list.push_back(text(&ordered.Item(i)));
    return {{"valueOrder", ordering.GetValueOrder()}, {"texts", list}};
}

template <class ValueOf>
Json listJson(const Column& column, size_t rows, ValueOf valueOf) {
    Json list = Json::array();
    for (size_t row = 0; row < rows; ++row) {
        list.push_back(column.isMissing(row) ? Json() : Json(valueOf(row)));
    }
    return list;
}

}  // namespace

Json bookJson(const Workbook& workbook, const Options& options) {
    return {{"file", validUtf8(options.book)}, {"missingValue", workbook.missing()}};
}

Json worksheetJson(const LoadedWorksheet& worksheet) {
    const IWorksheet& host = *worksheet.host;
    return {{"key", worksheet.key},
            {"title", validUtf8(worksheet.title)},
            {"layout", layoutJson(worksheet.layout)},
            {"columnsLeftOut", worksheet.leftOut.size()},
            {"version", number(host.GetVersion())},
            {"osVersion", host.GetOSVersion()},
            {"creator", validUtf8(host.GetCreator())},
            {"creationDates", validUtf8(host.GetCreationDates())},
            {"comments", validUtf8(host.GetComments())},
            {"hiddenColumnsUsed", host.GetHiddenColumnsUsed()},
            {"ddeLinks", host.GetDDELinkCount()},
            {"view", viewJson(*host.GetView())},
            {"formulas", formulaJson(*host.GetFormulaManager())}};
}

Json columnJson(const Column& column, size_t most) {
    const size_t rows = std::min(column.rows(), most);
    Json json = columnHead(column);
    if (column.kind() == Kind::Text) {
        json["ordering"] = orderingJson(column);
        json["values"] =
            listJson(column, rows, [&](size_t row) { return validUtf8(column.text(row)); });
        return json;
    }
    json["values"] = listJson(column, rows, [&](size_t row) { return number(column.number(row)); });
    if (column.kind() == Kind::DateTime) {
        json["iso"] = listJson(column, rows, [&](size_t row) { return column.exact(row); });
    }
    json["shown"] =
        listJson(column, rows, [&](size_t row) { return validUtf8(column.shown(row)); });
    return json;
}

namespace {

void writeWorksheet(const LoadedWorksheet& worksheet, size_t most, Output& output) {
    output.write(opened(worksheetJson(worksheet)) + ",\"columns\":[");
    for (const Column& column : worksheet.columns) {
        if (&column != &worksheet.columns.front()) output.write(",");
        output.write(dumped(columnJson(column, most)));
    }
    output.write("]}");
}

}  // namespace

void writeJson(Workbook& workbook, const Options& options, Output& output) {
    const std::vector<SheetEntry> sheets = workbook.worksheets();
    output.write(opened(bookJson(workbook, options)) + ",\"worksheets\":[");
    for (size_t i = 0; i < sheets.size(); ++i) {
        if (i > 0) output.write(",");
        writeWorksheet(workbook.load(sheets[i]), options.head.value_or(SIZE_MAX), output);
    }
    output.write("]}\n");
}

std::string failureJson(const std::string& book, const Failure& failure) {
    const Json json = {
        {"file", validUtf8(book)},
        {"failure", {{"exitCode", failure.code()}, {"text", validUtf8(failure.what())}}}};
    return dumped(json) + "\n";
}

}  // namespace dp::tool
