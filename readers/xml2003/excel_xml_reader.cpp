#include "dpxlsx/readers/xml2003/excel_xml_reader.h"

#include <iterator>
#include <stdexcept>
#include <utility>

#include <boost/lexical_cast.hpp>

#include "dpxlsx/formats/style_classification.h"
#include "dpxlsx/readers/xml2003/reading.h"
#include "dpxlsx/store/text_cleaning.h"

// What all readers of workbooks share.
namespace dp {

namespace {

// The integer of `length` characters from `position`. Throws std::out_of_range when the text ends
// before it and boost::bad_lexical_cast when it is no number.
int dateField(const std::string& text, std::size_t position, std::size_t length) {
    if (position > text.size()) throw std::out_of_range("basic_string::substr");
    return boost::lexical_cast<int>(text.substr(position, length));
}

const std::string& orDefault(std::string& mask, const char* usual) {
    if (mask.empty()) mask = usual;
    return mask;
}

}  // namespace

// The contract takes its texts by value.
// NOLINTNEXTLINE(performance-unnecessary-value-param)
ExcelXmlReader::ExcelXmlReader(std::string path, std::string shortDate, double missing,
                               IExcelDataProvider* receiver, IDateTimeVariableFormat* helper)
    : shortDateFormat(std::move(shortDate)),
      missingValue(missing),
      provider(receiver),
      dateTimeHelper(helper) {
    xmlReader.mInitialize(path);
    mInitialize();
    reading_ = std::make_unique<Reading>(xmlReader);
}

ExcelXmlReader::~ExcelXmlReader() = default;

void ExcelXmlReader::mInitialize() {
    elementNames.assign(std::begin(kCellElements), std::end(kCellElements));
    percentFormats = {"0.00%", "0%"};
    currencyFormats = {R"("$"#,##0.00_);[Red]\("$"#,##0.00\))", R"("$"#,##0.00_);\("$"#,##0.00\))",
                       R"("$"#,##0_);[Red]\("$"#,##0\))", R"("$"#,##0_);\("$"#,##0\))"};
    scientificFormats = {"0.00E+00"};
    fixedFormats = {"0.00", "0"};
}

IVariableFormat* ExcelXmlReader::createVextralNumericFormat(int styleIndex) {
    const bool isDateTime = isInTable(styleIndex) && IsDateTimeFormatType(typeAt(styleIndex));
    return createStyleFormat(styles, styleIndex, isDateTime);
}

EXCEL_FORMAT_TYPE ExcelXmlReader::GetExcelFormatType(int styleIndex) const {
    return isInTable(styleIndex) ? typeAt(styleIndex) : EXCEL_FORMAT_NONE;
}

bool ExcelXmlReader::isInTable(int styleIndex) const {
    return styleIndex >= 0 && static_cast<std::size_t>(styleIndex) < styles.size();
}

EXCEL_FORMAT_TYPE ExcelXmlReader::typeAt(int styleIndex) const {
    return static_cast<EXCEL_FORMAT_TYPE>(styles[static_cast<std::size_t>(styleIndex)].formatType);
}

bool ExcelXmlReader::IsDateTimeFormatType(EXCEL_FORMAT_TYPE type) { return isDateTimeType(type); }

const std::string& ExcelXmlReader::GetTimeMask() { return orDefault(timeMask, "hh:mm"); }
const std::string& ExcelXmlReader::GetTimeSeparator() { return orDefault(timeSeparator, ":"); }
const std::string& ExcelXmlReader::GetAMPMMask() { return orDefault(ampmMask, "AM/PM"); }

void ExcelXmlReader::mSetFmtType(xStyle& style) { setFormatType(style); }

void ExcelXmlReader::mReplaceDescWithFormat() {
    replaceDescriptiveNames(styles, {.shortDate = shortDateFormat,
                                     .percent = percentFormats.front(),
                                     .currency = currencyFormats.front(),
                                     .scientific = scientificFormats.front(),
                                     .fixed = fixedFormats.front()});
}

void ExcelXmlReader::UpdateFormatsForLocale() { updateFormatsForLocale(styles, masks()); }

void ExcelXmlReader::GetLocaleDefaultDateTimeFormat(std::string& code, unsigned flags) {
    composeDateTimeCode(code, flags, masks());
}

DateTimeMasks ExcelXmlReader::masks() {
    return {.time = [this]() -> const std::string& { return GetTimeMask(); },
            .separator = [this]() -> const std::string& { return GetTimeSeparator(); },
            .ampm = [this]() -> const std::string& { return GetAMPMMask(); }};
}

bool ExcelXmlReader::mSearchStyleIndexForFormat(const std::string& id, xStyle*& style, int& index) {
    index = static_cast<int>(reading_->styleById.find(styles, id));
    style = index < 0 ? nullptr : &styles[static_cast<std::size_t>(index)];
    return style != nullptr;
}

bool ExcelXmlReader::mGetFormat(unsigned column, unsigned row, int& styleIndex) {
    styleIndex = -1;
    const auto resolve = [&](const std::vector<xStyleRange>& ranges, auto& index, unsigned place) {
        const std::ptrdiff_t range = index.find(ranges, place);
        if (range < 0) return false;
        currentStyleId = ranges[static_cast<std::size_t>(range)].styleId;
        mSearchStyleIndexForFormat(currentStyleId, currentStyle, styleIndex);
        return true;
    };
    if (resolve(columnStyles, reading_->styleByColumn, column)) return true;
    if (resolve(rowStyles, reading_->styleByRow, row)) return true;
    if (!currentStyle) return false;
    mSearchStyleIndexForFormat(currentStyleId, currentStyle, styleIndex);
    return true;
}

double ExcelXmlReader::mFormatExcelDateTime(const std::string& text) {
    const int year = dateField(text, 0, 4);
    const int month = dateField(text, 5, 2);
    int day = dateField(text, 8, 2);
    const int hour = dateField(text, 11, 2);
    const int minute = dateField(text, 14, 2);
    const int second = dateField(text, 17, 2);
    const int millisecond = dateField(text, 20, 3);
    // Times without a date are written with the date 1899-12-31. The helper gets 1899-12-30
    // instead, the day from which it counts serial days.
    if (year == 1899 && month == 12 && day == 31) day = 30;
    if (!dateTimeHelper) return missingValue;
    return dateTimeHelper->GenerateTime(year, month, day, hour, minute, second, millisecond);
}

void ExcelXmlReader::deliver(const ExternalDataRecord& record) {
    worksheetEmpty = false;
    provider->AddExternalDataRecord(record);
}

void ExcelXmlReader::beginWorksheet(const std::string& name) {
    worksheetEmpty = true;
    provider->AddWorksheet(name.c_str());
    provider->SetWorksheetIndex(worksheetIndex++);
}

void ExcelXmlReader::removeEmptyWorksheets(const std::vector<unsigned>& emptySheets) {
    for (auto index = emptySheets.rbegin(); index != emptySheets.rend(); ++index) {
        provider->RemoveWorksheet(static_cast<int>(*index));
        --worksheetIndex;
    }
    if (worksheetIndex != 0) provider->SetWorksheetIndex(0);
}

bool ExcelXmlReader::IsStringAllBlank(const std::string& text) { return isAllSpaces(text); }

}  // namespace dp
