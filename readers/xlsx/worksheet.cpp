#include <string>

#include "dpxlsx/readers/xlsx/any_worksheet.h"
#include "dpxlsx/readers/xlsx/cell_assembler.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/opened_package.h"
#include "dpxlsx/readers/xlsx/plain_worksheet.h"

// The cells of one worksheet part, in a single forward pass unless it turns out not to be plain.
namespace dp {

void ExcelXLSXReader::readWorksheet(const std::string& target) {
    const std::string part = resolveTarget(opened_->dir, target);
    opened_->repeatedParts.visit(part);
    opened_->textBudget.addPart(part);
    CellAssembler plain(*this);
    if (plain.take([&] { return readPlainWorksheet(part, plain); })) return;
    CellAssembler any(*this, plain.delivered());
    any.take([&] {
        readAnyWorksheet(part, any);
        return true;
    });
}

void ExcelXLSXReader::mReadExcel2007Worksheet(const std::string& target) {
    resolveNumberKinds();  // a derived reader may have changed the style table
    readWorksheet(target);
}

}  // namespace dp
