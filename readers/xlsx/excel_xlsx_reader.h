#pragma once

#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/readers/xml2003/excel_xml_reader.h"

namespace dp {

// Reads an unpacked .xlsx package: styles, shared strings, relationships, then the worksheets of
// the workbook's list in order. Defined in excel_xlsx_reader.cpp (the workbook),
// shared_strings.cpp, styles.cpp and worksheet.cpp.
class DPXLSX_API ExcelXLSXReader : public ExcelXmlReader {
  public:
    // `dir` is the directory of the unpacked package, and `hasSharedStrings` tells whether it has
    // that part. Throws CmXmlException when the workbook part cannot be opened.
    ExcelXLSXReader(const std::string& dir, bool hasSharedStrings, std::string shortDateFormat,
                    double missingValue, IExcelDataProvider* provider,
                    IDateTimeVariableFormat* dateTimeHelper);
    ~ExcelXLSXReader() override;

    void mReadExcelWorkbook() override;

    // Reads the texts that cells share by index, in place of those read before. Throws
    // CmXmlException, like the next one.
    void mReadSharedStrings();
    // Reads the number formats, in place of the style table before, and which of them the cell
    // formats use.
    void mReadExcel2007Styles();
    // Appends the built-in number formats to the style table.
    void mAddPredefined2007Styles();
    // Delivers the cells of the worksheet part that the relationship target names, with the current
    // styles and shared strings. Throws CmXmlException, also for a value in a row or column that no
    // worksheet has, and when parts were read again and again, 64 MiB in all.
    void mReadExcel2007Worksheet(const std::string& target);
    // Copies the target of the first relationship called `id`; leaves `target` alone without one.
    // For use while mReadExcelWorkbook runs.
    void mSearchWorkbookRelationships(const std::string& id, std::string& target);
    // Decodes the escapes by which a package writes control characters, in place.
    static void mParseCharString(std::string& text);

  protected:
    // For readers that find the parts themselves; `workbookPart` is the path of that part.
    ExcelXLSXReader(const std::string& workbookPart, std::string shortDateFormat,
                    double missingValue, IExcelDataProvider* provider,
                    IDateTimeVariableFormat* dateTimeHelper);

  private:
    friend class CellAssembler;
    struct OpenedPackage;

    void readSheets();
    void readSheet(std::vector<unsigned>& emptySheets);
    void resolveNumberKinds();
    // Like mReadExcel2007Worksheet, but with the number kinds determined before.
    void readWorksheet(const std::string& target);

    bool hasSharedStrings;
    std::string xlDir;
    std::vector<std::string> relationshipIds;
    std::vector<std::string> relationshipTargets;
    std::vector<std::string> sharedStrings;  // stays empty: opened_ has the texts
    std::vector<std::string> cellXfNumFmtIds;
    std::unique_ptr<OpenedPackage> opened_;  // what only the library's own code needs
};

namespace excel_xlsx {

// The names of an unpacked package's worksheets in workbook order, empty worksheets included.
// Throws CmXmlException.
DPXLSX_API void GetWorksheets(const std::string& dir, std::vector<std::string>& names);

}  // namespace excel_xlsx

}  // namespace dp
