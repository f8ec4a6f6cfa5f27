#include <string_view>
#include <utility>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/readers/xml/attributes.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "dpxlsx/readers/xml/silence.h"
#include "dpxlsx/readers/xml2003/reading.h"

// XML Spreadsheet 2003: the workbook, its styles and its worksheets.
namespace dp {

namespace {

[[noreturn]] void fail() { throw CmXmlException(kXmlError); }

// The 0-based number of a 1-based index attribute, where there is one.
bool readIndex(XmlReader& reader, unsigned& index) {
    unsigned oneBased = 0;
    if (!reader.mReadAttribute(oneBased, "ss:Index") || oneBased == 0) return false;
    index = oneBased - 1;
    return true;
}

}  // namespace

void ExcelXmlReader::mReadExcelWorkbook() {
    const SilentLibxml2 silent;
    mReadExcelStyles();
    const auto byId = reading_->styleById.use();
    std::vector<unsigned> emptySheets;
    emptySheets.reserve(100);
    while (!xmlReader.endOfFile && xml::mReadForElements(xmlReader, {"Worksheet"}) != -1) {
        columnStyles.clear();
        rowStyles.clear();
        mReadExcelWorksheet(emptySheets);
    }
    removeEmptyWorksheets(emptySheets);
}

void ExcelXmlReader::mReadExcelStyles() {
    enum { kStyle, kNumberFormat };
    std::string styleId;
    while (true) {
        const int element = xml::mReadForElements(
            xmlReader, {"Style", "NumberFormat", "Worksheet", "WorksheetOptions"});
        if (element == -1) fail();
        if (element == kStyle) {
            if (std::string id = xmlReader.attributeText("ss:ID"); !id.empty())
                styleId = std::move(id);
        } else if (element == kNumberFormat) {
            if (std::string code = xmlReader.attributeText("ss:Format");
                !code.empty() && code.size() <= kFormatCodeSize) {
                styles.push_back({std::exchange(styleId, {}), std::move(code), EXCEL_FORMAT_NONE});
                mSetFmtType(styles.back());
            }
        } else {
            break;
        }
        // Moves on in every case, even when the element had no such attribute: otherwise it would
        // be visited again.
        xmlReader.readToElement();
    }
    mReplaceDescWithFormat();
    UpdateFormatsForLocale();
}

void ExcelXmlReader::mReadExcelWorksheet(std::vector<unsigned>& emptySheets) {
    const auto byId = reading_->styleById.use();
    const auto byColumn = reading_->styleByColumn.use();
    const auto byRow = reading_->styleByRow.use();
    const std::string name = xmlReader.attributeText("ss:Name");
    const int element = xml::mReadForElements(xmlReader, {"Table", "WorksheetOptions"});
    if (element == -1) fail();
    if (element == 1) return;  // no table: the worksheet is skipped

    unsigned columnCount = 0;
    unsigned rowCount = 0;
    xmlReader.mReadAttribute(columnCount, "ss:ExpandedColumnCount");
    xmlReader.mReadAttribute(rowCount, "ss:ExpandedRowCount");
    mReadExcelWorksheetDataHeader();
    beginWorksheet(name);
    if (!isOnElement("WorksheetOptions")) mReadExcelWorksheetData(columnCount, rowCount);
    if (worksheetEmpty) emptySheets.push_back(static_cast<unsigned>(worksheetIndex - 1));
}

bool ExcelXmlReader::isOnElement(const char* name) const {
    const char* current = xmlReader.nodeName();
    return current && std::string_view(current) == name;
}

bool ExcelXmlReader::isStyle(const std::string& id) {
    return reading_->styleById.find(styles, id) >= 0;
}

void ExcelXmlReader::mReadExcelWorksheetDataHeader() {
    unsigned column = 0;
    int element = 0;
    while ((element = xml::mReadForElements(xmlReader, {"Column", "Row", "WorksheetOptions"})) ==
           0) {
        readIndex(xmlReader, column);
        std::string style = xmlReader.attributeText("ss:StyleID");
        if (!style.empty() && isStyle(style)) columnStyles.push_back({column, 0, std::move(style)});
        if (column < kWorksheetColumns) ++column;
        xmlReader.readToElement();
    }
    if (element == -1) fail();
}

// Ends with the row or the declared columns, whichever comes first: a table may declare any number
// of columns.
void ExcelXmlReader::readRow(unsigned row, unsigned columnCount) {
    unsigned column = 0;
    while (column < columnCount) {
        const bool tableEnded = mReadExcelWorksheetCell(column, row, columnCount);
        if (tableEnded || xmlReader.endOfFile || column >= columnCount) return;
        ++column;
    }
}

void ExcelXmlReader::mReadExcelWorksheetData(unsigned columnCount, unsigned rowCount) {
    if (rowCount == 0) return;
    unsigned row = 0;
    int element = 0;
    while ((element = xml::readToOneOf(xmlReader, reading_->rowNames)) == 0) {
        Attributes attributes(xmlReader);
        unsigned index = 0;  // 1-based
        if (const char* text = attributes.find("Index", "ss"))
            CmXmlCast::instance().mCast(index, text);
        if (index > row) row = index - 1;
        const char* style = attributes.find("StyleID", "ss");
        if (style && isStyle(style)) rowStyles.push_back({0, row, style});
        if (!xmlReader.readNode()) fail();
        readRow(row, columnCount);
        if (xmlReader.endOfFile) return;
        if (++row >= rowCount) return;
    }
    if (element == -1 && !xmlReader.endOfFile) fail();
}

}  // namespace dp
