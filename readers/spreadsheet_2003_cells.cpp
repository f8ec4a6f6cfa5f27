#include <algorithm>
#include <limits>
#include <string_view>
#include <utility>

#include <libxml/xmlreader.h>

#include "readers/attributes.h"
#include "readers/cell_reference.h"
#include "readers/cm_xml_cast.h"
#include "readers/excel_xml_reader.h"

// XML Spreadsheet 2003: the cells of a row.
namespace dp {

namespace {

// Positions in elementNames.
enum Element { kNone = -1, kCell, kData, kWorksheetOptions, kRow, kPrefixedData, kComment };

unsigned saturatingSum(unsigned left, unsigned right) {
    const unsigned room = std::numeric_limits<unsigned>::max() - left;
    return left + std::min(right, room);
}

ExternalDataRecord recordAt(unsigned column, unsigned row, ExternalCellType type) {
    if (row >= kWorksheetRows || column >= kWorksheetColumns) throw CmXmlException(kXmlError);
    ExternalDataRecord record(0, 0, row, column);
    record.cell.type = type;
    return record;
}

}  // namespace

bool ExcelXmlReader::mReadExcelWorksheetCell(unsigned& column, unsigned row, unsigned columnCount) {
    unsigned mergeAcross = 0;
    bool cellSeen = false;
    while (true) {
        switch (xml::mReadForElements(xmlReader, elementNames)) {
            case kCell:
                if (std::exchange(cellSeen, true)) column = saturatingSum(column, 1);
                beginCell(column, mergeAcross);
                if (!xmlReader.readToElement()) return false;
                break;
            case kData:
            case kPrefixedData:
                mReadExcelWorksheetCellData(column, row);
                column = saturatingSum(column, mergeAcross);
                return false;
            case kWorksheetOptions:
                return true;
            case kRow:
                column = std::max(column, columnCount);
                return false;
            case kComment:
                if (xmlTextReaderNext(xmlReader.textReader) != 1) throw CmXmlException(kXmlError);
                break;
            default:
                if (xmlReader.endOfFile) return false;
                throw CmXmlException(kXmlError);
        }
    }
}

// Reads the attributes of a cell: its place, its style, and how many columns it covers.
void ExcelXmlReader::beginCell(unsigned& column, unsigned& mergeAcross) {
    Attributes attributes(xmlReader);
    unsigned index = 0;
    if (const char* text = attributes.find("Index", "ss")) CmXmlCast::instance().mCast(index, text);
    if (index > column) column = index - 1;

    currentStyleId.clear();
    currentStyle = nullptr;
    if (const char* id = attributes.find("StyleID", "ss"); id && *id != '\0') {
        currentStyleId = id;
        int ignored = -1;
        mSearchStyleIndexForFormat(currentStyleId, currentStyle, ignored);
    }

    mergeAcross = 0;
    if (const char* text = attributes.find("MergeAcross", "ss"))
        CmXmlCast::instance().mCast(mergeAcross, text);
    // Wider than a worksheet, or negative: it would hide the cells behind it.
    if (mergeAcross >= kWorksheetColumns) mergeAcross = 0;
}

void ExcelXmlReader::mReadExcelWorksheetCellData(unsigned column, unsigned row) {
    const bool hasContent = xmlTextReaderIsEmptyElement(xmlReader.textReader) != 1;
    Attributes attributes(xmlReader);
    const char* typeName = attributes.find("Type", "ss");
    const std::string type = typeName ? typeName : "";
    xmlReader.readNode();
    if (!hasContent) return;

    const bool inPreview = !provider->IsPreviewing() ||
                           (row < static_cast<unsigned>(provider->GetPreviewNumberOfRows()) &&
                            column < static_cast<unsigned>(provider->GetPreviewNumberOfColumns()));
    const char* value = xmlReader.nodeValue();
    if (type == "Number" || type == "Boolean") {
        if (!value) return;
        ExternalDataRecord record = recordAt(column, row, CELL_NUMBER);
        CmXmlCast::instance().mCast(record.cell.numValue, value);
        mAddExternalDataRecord(record, inPreview);
    } else if (type == "DateTime") {
        if (!value || *value == '\0') return;
        ExternalDataRecord record = recordAt(column, row, CELL_DATETIME);
        record.cell.numValue = inPreview ? mFormatExcelDateTime(value) : missingValue;
        mAddExternalDataRecord(record, inPreview);
    } else if (type == "String") {
        std::string text = readStringData();
        if (IsStringAllBlank(text)) return;
        ExternalDataRecord record = recordAt(column, row, CELL_TEXT);
        record.cell.textValue = std::move(text);
        mAddExternalDataRecord(record, inPreview);
    }
}

// The text from the current node to the end of the data, that of formatted runs included.
std::string ExcelXmlReader::readStringData() {
    std::string text;
    do {
        const int type = xmlReader.nodeType();
        if (type == XML_READER_TYPE_TEXT || type == XML_READER_TYPE_SIGNIFICANT_WHITESPACE)
            text += xmlReader.nodeValue();
        else if (type == XML_READER_TYPE_END_ELEMENT &&
                 (isOnElement("Data") || isOnElement("ss:Data")))
            break;
    } while (xmlReader.readNode());
    return text;
}

void ExcelXmlReader::mAddExternalDataRecord(ExternalDataRecord& record, bool lookUpFormat) {
    int styleIndex = -1;
    if (lookUpFormat && mGetFormat(record.column, record.row, styleIndex)) {
        record.cell.formatIndex = styleIndex;
        const int type = currentStyle ? currentStyle->formatType : EXCEL_FORMAT_NONE;
        // A time without a date stays a number in this format.
        if (record.cell.type == CELL_NUMBER &&
            (type == EXCEL_FORMAT_DATE || type == EXCEL_FORMAT_DATETIME))
            record.cell.type = CELL_DATETIME;
    }
    deliver(record);
}

}  // namespace dp
