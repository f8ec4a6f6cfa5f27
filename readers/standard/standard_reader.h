#pragma once

#include <string>
#include <vector>

#include "dpxlsx/readers/standard/cell_content.h"
#include "dpxlsx/readers/standard/package_parts.h"
#include "dpxlsx/readers/standard/worksheet_part.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/repeated_parts.h"
#include "dpxlsx/readers/xlsx/text_budget.h"

namespace dp {

namespace standard {

// An unpacked package and the name of its workbook part, empty when it has none.
struct WorkbookPackage {
    // Throws the file system's error and CmXmlException.
    explicit WorkbookPackage(const std::string& dir);

    PackageParts parts;
    std::string workbookPart;
};

}  // namespace standard

// Reads an unpacked .xlsx package by the standard, as spreadsheet programs practise it.
class StandardReader : public ExcelXLSXReader {
  public:
    // `dir` is the directory of the unpacked package. Throws CmXmlException when it has no workbook
    // part that can be opened.
    StandardReader(const std::string& dir, std::string shortDateFormat, double missingValue,
                   IExcelDataProvider* provider, IDateTimeVariableFormat* dateTimeHelper);
    ~StandardReader() override;

    void mReadExcelWorkbook() override;
    IVariableFormat* createVextralNumericFormat(int styleIndex) override;
    EXCEL_FORMAT_TYPE GetExcelFormatType(int styleIndex) const override;

  private:
    StandardReader(standard::WorkbookPackage package, std::string shortDateFormat,
                   double missingValue, IExcelDataProvider* provider,
                   IDateTimeVariableFormat* dateTimeHelper);

    void readReferences(const std::vector<standard::Relationship>& relationships);
    void readWorksheet(const std::string& path);
    void take(standard::CellPosition position, ExternalDataRecordCell&& content);

    standard::WorkbookPackage package_;
    standard::CellReferences references_;
    TextBudget textBudget_;
    RepeatedParts repeatedParts_;
};

namespace standard {

// Whether the package that is unpacked in `dir` has a workbook part in XML that can be read. Throws
// the file system's error.
bool isWorkbook(const std::string& dir);

// The names of its worksheets in workbook order, empty worksheets included. Throws CmXmlException.
void listWorksheets(const std::string& dir, std::vector<std::string>& names);

}  // namespace standard

}  // namespace dp
