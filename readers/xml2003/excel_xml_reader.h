#pragma once

#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/formats/style.h"
#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_data_provider.h"
#include "dpxlsx/model/host/i_variable_format.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "dpxlsx/store/external_data_record.h"

namespace dp {

struct DateTimeMasks;

// Reads a workbook into a provider. This class reads XML Spreadsheet 2003 documents and owns what
// all readers share: the style table and the formats made from it. The provider and the date-time
// helper are borrowed. Structural errors end as CmXmlException; what was delivered until then stays
// with the provider. The order of the virtual operations is part of the binary contract. Defined in
// excel_xml_reader.cpp (the style table and what all readers share), spreadsheet_2003.cpp (styles,
// worksheets and rows of the 2003 format) and spreadsheet_2003_cells.cpp (its cells).
class DPXLSX_API ExcelXmlReader {
  public:
    // Opens the document at `path`. `shortDateFormat` is the code that "Short Date" stands for,
    // `missingValue` the provider's missing number. Throws CmXmlException.
    ExcelXmlReader(std::string path, std::string shortDateFormat, double missingValue,
                   IExcelDataProvider* provider, IDateTimeVariableFormat* dateTimeHelper);
    ExcelXmlReader(const ExcelXmlReader&) = delete;
    ExcelXmlReader& operator=(const ExcelXmlReader&) = delete;
    virtual ~ExcelXmlReader();

    // Sets the index (0-based, 0 by default) of the first worksheet: the number of worksheets of
    // other workbooks that the provider already has. To be called before reading.
    void startAtWorksheet(int index) { worksheetIndex = index; }

    // Delivers every worksheet with its cells; to be called once. A value in a row or column that
    // no worksheet has is an error.
    virtual void mReadExcelWorkbook();
    // A new format for the style at `styleIndex`, owned by the caller; the automatic numeric format
    // for an index outside the table. A date-time code loses its backslashes in the table.
    virtual IVariableFormat* createVextralNumericFormat(int styleIndex);
    // The style's EXCEL_FORMAT_TYPE, 0 for an index outside the table.
    virtual EXCEL_FORMAT_TYPE GetExcelFormatType(int styleIndex) const;
    // True for the date, time and date-time types.
    virtual bool IsDateTimeFormatType(EXCEL_FORMAT_TYPE type);
    // The masks of which default date-time codes are made: "hh:mm", ":" and "AM/PM". Valid as long
    // as the reader.
    virtual const std::string& GetTimeMask();
    virtual const std::string& GetTimeSeparator();
    virtual const std::string& GetAMPMMask();

    // --- The style table ---
    // Sets the names of elements and the codes of descriptive formats; the constructor does it.
    void mInitialize();
    // Classifies one style that was read from the file; may rewrite its code.
    void mSetFmtType(xStyle& style);
    // Replaces descriptive format names in the whole table.
    void mReplaceDescWithFormat();
    // Gives the built-in date-time styles the default codes of the masks.
    void UpdateFormatsForLocale();
    // Composes the default code of the DateTimePart `flags` into `code`; without date and time part
    // `code` stays as it is.
    void GetLocaleDefaultDateTimeFormat(std::string& code, unsigned flags);
    // The default style of a cell position (0-based), or the style resolved last. False when there
    // is none; `styleIndex` is -1 when the style is not in the table.
    bool mGetFormat(unsigned column, unsigned row, int& styleIndex);
    // The first style called `id` and its index; null and -1 when there is none.
    bool mSearchStyleIndexForFormat(const std::string& id, xStyle*& style, int& index);
    // The serial day number of a text such as "2010-01-05T10:30:00.000", as the date-time helper
    // gives it. Throws std::out_of_range for a text that ends before a field and
    // boost::bad_lexical_cast for one with a field that is no number. The missing value when there
    // is no helper.
    double mFormatExcelDateTime(const std::string& text);

    // --- XML Spreadsheet 2003, in the order of the document; reading throws CmXmlException ---
    // Reads the style table as far as the first worksheet.
    void mReadExcelStyles();
    // Appends the worksheet's index to `emptySheets` when it delivered nothing.
    void mReadExcelWorksheet(std::vector<unsigned>& emptySheets);
    // Reads the default styles of columns, as far as the first row.
    void mReadExcelWorksheetDataHeader();
    // Delivers the cells of at most `rowCount` rows and `columnCount` columns.
    void mReadExcelWorksheetData(unsigned columnCount, unsigned rowCount);
    // Delivers the next value of the row, if there is one, and advances `column`; true when it
    // reached the options that follow the table.
    bool mReadExcelWorksheetCell(unsigned& column, unsigned row, unsigned columnCount);
    // Delivers the value of the current data element as a cell at `column` and `row` (0-based),
    // unless it has none.
    void mReadExcelWorksheetCellData(unsigned column, unsigned row);
    // Delivers a cell. With `lookUpFormat` the cell first gets the style of its position, and a
    // number with a date or date-time format becomes a date-time.
    void mAddExternalDataRecord(ExternalDataRecord& record, bool lookUpFormat);
    // True for the empty text and for one of spaces only.
    static bool IsStringAllBlank(const std::string& text);

  protected:
    // Delivers a record and notes that the worksheet is not empty.
    void deliver(const ExternalDataRecord& record);
    // Announces a worksheet to the provider and makes it the current one.
    void beginWorksheet(const std::string& name);
    // Removes the worksheets that delivered nothing and selects the first one.
    void removeEmptyWorksheets(const std::vector<unsigned>& emptySheets);

    XmlReader xmlReader;
    int worksheetIndex = 0;  // of the next worksheet
    // Derived classes may change the three tables in any way between calls. While a call reads a
    // document or a worksheet, entries may only be appended; while it reads a package, entries that
    // are appended have no effect.
    std::vector<xStyle> styles;
    std::vector<xStyleRange> columnStyles;
    std::vector<xStyleRange> rowStyles;
    std::string currentStyleId;
    xStyle* currentStyle = nullptr;
    std::vector<std::string> elementNames;
    std::string shortDateFormat;
    std::vector<std::string> percentFormats;
    std::vector<std::string> currencyFormats;
    std::vector<std::string> scientificFormats;
    std::vector<std::string> fixedFormats;
    double missingValue;
    bool worksheetEmpty = true;  // nothing was delivered for the current worksheet
    IExcelDataProvider* provider;
    IDateTimeVariableFormat* dateTimeHelper;
    std::string timeMask;
    std::string timeSeparator;
    std::string ampmMask;

  private:
    struct Reading;

    DateTimeMasks masks();
    bool isInTable(int styleIndex) const;
    EXCEL_FORMAT_TYPE typeAt(int styleIndex) const;
    bool isOnElement(const char* name) const;
    bool isStyle(const std::string& id);
    void readRow(unsigned row, unsigned columnCount);
    void beginCell(unsigned& column, unsigned& mergeAcross);
    void setCurrentStyle(const char* id);
    ExternalCellType dataType();
    bool readData(bool inPreview);
    void readStringData(std::string& text);

    std::unique_ptr<Reading> reading_;  // what only the library's own code needs
};

}  // namespace dp
