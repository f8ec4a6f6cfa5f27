#pragma once

#include <string>
#include <vector>

#include "dpxlsx/readers/xlsx/relationships.h"
#include "dpxlsx/readers/xlsx/repeated_parts.h"
#include "dpxlsx/readers/xlsx/shared_string_table.h"
#include "dpxlsx/readers/xlsx/text_budget.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"

namespace dp {

// The kind of a number cell according to its style.
struct NumberKind {
    ExternalCellType type = CELL_NUMBER;
    int formatIndex = -1;
};

// Reads an unpacked .xlsx package: styles, shared strings, relationships, then the worksheets of
// the workbook's list in order.
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

  private:
    friend class CellAssembler;
    // Like mReadExcel2007Worksheet, but with the number kinds determined before.
    friend void readWorksheet(ExcelXLSXReader& reader, const std::string& target);

    void readSheets();
    void readSheet(std::vector<unsigned>& emptySheets);
    void resolveNumberKinds();

    bool hasSharedStrings;
    std::string xlDir;
    std::vector<std::string> relationshipIds;
    std::vector<std::string> relationshipTargets;
    SharedStringTable sharedStrings;  // decoded; blank texts, which cells do not deliver, are empty
    std::vector<std::string> cellXfNumFmtIds;

    std::string packageDir;
    RelationshipIndex relationshipIndex;
    std::vector<NumberKind> numberKinds;  // by position in cellXfNumFmtIds
    TextBudget textBudget;
    RepeatedParts repeatedParts;
};

namespace excel_xlsx {

// The names of an unpacked package's worksheets in workbook order, empty worksheets included.
// Throws CmXmlException.
DPXLSX_API void GetWorksheets(const std::string& dir, std::vector<std::string>& names);

}  // namespace excel_xlsx

}  // namespace dp
