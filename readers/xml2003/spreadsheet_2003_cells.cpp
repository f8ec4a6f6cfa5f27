#include <algorithm>
#include <cstring>
#include <limits>
#include <string_view>
#include <utility>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/readers/xml/attributes.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "dpxlsx/readers/xml2003/reading.h"

// XML Spreadsheet 2003: the cells of a row.
namespace dp {

namespace {

unsigned saturatingSum(unsigned left, unsigned right) {
    const unsigned room = std::numeric_limits<unsigned>::max() - left;
    return left + std::min(right, room);
}

bool hasPrefix(const xmlAttr* attribute) {
    const xmlChar* prefix = attribute->ns ? attribute->ns->prefix : nullptr;
    return prefix && std::strcmp(reinterpret_cast<const char*>(prefix), "ss") == 0;
}

// The attribute's CellAttribute, -1 for another one.
int attributeIn(const xml::KnownNames& names, const xmlAttr* attribute) {
    if (!hasPrefix(attribute)) return -1;
    return names.find(reinterpret_cast<const char*>(attribute->name));
}

ExternalCellType typeOfData(std::string_view name) {
    if (name == "Number" || name == "Boolean") return CELL_NUMBER;
    if (name == "String") return CELL_TEXT;
    if (name == "DateTime") return CELL_DATETIME;
    return CELL_EMPTY;
}

}  // namespace

bool ExcelXmlReader::mReadExcelWorksheetCell(unsigned& column, unsigned row, unsigned columnCount) {
    unsigned mergeAcross = 0;
    bool cellSeen = false;
    while (true) {
        switch (xml::readToOneOf(xmlReader, reading_->cellNames)) {
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
                if (!xmlReader.skipElement()) throw CmXmlException(kXmlError);
                break;
            default:
                if (xmlReader.endOfFile) return false;
                throw CmXmlException(kXmlError);
        }
    }
}

// The type that the current data names.
ExternalCellType ExcelXmlReader::dataType() {
    Attributes attributes(xmlReader);
    for (const xmlAttr* a = attributes.first(); a; a = a->next)
        if (attributeIn(reading_->attributeNames, a) == kType)
            return typeOfData(attributes.valueOf(a));
    return CELL_EMPTY;
}

// Reads the attributes of a cell: its place, its style, and how many columns it covers.
void ExcelXmlReader::beginCell(unsigned& column, unsigned& mergeAcross) {
    Attributes attributes(xmlReader);
    unsigned index = 0;
    mergeAcross = 0;
    bool hasStyle = false;
    for (const xmlAttr* a = attributes.first(); a; a = a->next) {
        const int name = attributeIn(reading_->attributeNames, a);
        if (name == kStyleId) {
            setCurrentStyle(attributes.valueOf(a));
            hasStyle = true;
        } else if (name == kIndex) {
            CmXmlCast::instance().mCast(index, attributes.valueOf(a));
        } else if (name == kMergeAcross) {
            CmXmlCast::instance().mCast(mergeAcross, attributes.valueOf(a));
        }
    }
    if (index > column) column = index - 1;
    // A merge wider than a worksheet, or negative, would hide the cells that follow.
    if (mergeAcross >= kWorksheetColumns) mergeAcross = 0;
    if (hasStyle) return;
    currentStyleId.clear();
    currentStyle = nullptr;
}

void ExcelXmlReader::setCurrentStyle(const char* id) {
    currentStyleId = id;
    int ignored = -1;
    mSearchStyleIndexForFormat(currentStyleId, currentStyle, ignored);
}

void ExcelXmlReader::mReadExcelWorksheetCellData(unsigned column, unsigned row) {
    const bool hasContent = xmlTextReaderIsEmptyElement(xmlReader.textReader) != 1;
    ExternalDataRecord& record = reading_->record;
    record.initialize();
    record.cell.type = dataType();
    xml::readContent(xmlReader);
    const bool inPreview = !provider->IsPreviewing() ||
                           (row < static_cast<unsigned>(provider->GetPreviewNumberOfRows()) &&
                            column < static_cast<unsigned>(provider->GetPreviewNumberOfColumns()));
    if (!hasContent || !readData(inPreview)) return;
    requireInWorksheet(row, column);
    record.row = row;
    record.column = column;
    mAddExternalDataRecord(record, inPreview);
}

// Reads the value of the current data according to its type. False when there is none.
bool ExcelXmlReader::readData(bool inPreview) {
    ExternalDataRecordCell& cell = reading_->record.cell;
    if (cell.type == CELL_TEXT) {
        readStringData(cell.textValue);
        return !IsStringAllBlank(cell.textValue);
    }
    const char* value = xmlReader.nodeValue();
    if (cell.type == CELL_EMPTY || !value) return false;
    if (cell.type == CELL_NUMBER) {
        CmXmlCast::instance().mCast(cell.numValue, value);
        return true;
    }
    if (*value == '\0') return false;
    cell.numValue = inPreview ? mFormatExcelDateTime(value) : missingValue;
    return true;
}

// Appends the text from the current node to the end of the data, that of formatted runs included.
void ExcelXmlReader::readStringData(std::string& text) {
    do {
        const int type = xmlReader.nodeType();
        if (type == XML_READER_TYPE_TEXT || type == XML_READER_TYPE_SIGNIFICANT_WHITESPACE) {
            if (const char* value = xmlReader.nodeValue()) text += value;
        } else if (type == XML_READER_TYPE_END_ELEMENT) {
            const int element = reading_->cellNames.find(xmlReader.nodeName());
            if (element == kData || element == kPrefixedData) break;
        }
    } while (xmlReader.readNode());
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
