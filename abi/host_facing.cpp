// The classes whose layout hosts rely on, for scripts/check-abi: compiled apart from the library,
// so that the record of them is the same whatever the build.
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/fraction_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/formats/style.h"
#include "dpxlsx/formats/text_variable_format.h"
#include "dpxlsx/model/columns.h"
#include "dpxlsx/model/formula.h"
#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/i_finders.h"
#include "dpxlsx/model/rows.h"
#include "dpxlsx/model/worksheet.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "dpxlsx/store/blank_rows.h"
#include "dpxlsx/store/cell_column.h"
#include "dpxlsx/store/external_data_record.h"
#include "dpxlsx/store/read_options.h"
#include "dpxlsx/store/worksheet_cells.h"

namespace dp {

DPXLSX_API void interfaces(IDataProvider*, IExcelDataProvider*, IWorksheetFinder*, IVariableFinder*,
                           IModel*, IColumn*, INumericColumn*, ITextColumn*, IColumnView*,
                           IColumnOrdering*, IVariable*, IResource*, IString*,
                           IReadOnlyCollection<int>*, IReadOnlyCollection<IString&>*, IRows*,
                           IWorksheet*, IWorksheetView*, IFormulaManager*, IFormulaNode*,
                           IFormulaVariableNode*, IFormulaModelNode*, IFormulaModelVariableNode*,
                           IExpressionError*) {}

DPXLSX_API void formats(IVariableFormat*, INumericVariableFormat*, IPercentageVariableFormat*,
                        IFractionVariableFormat*, ITextVariableFormat*, IDateTimeVariableFormat*) {}

DPXLSX_API void objects(String*, ReadOnlyCollection<int>*, ReadOnlyStringCollection<IString&>*,
                        NumericColumn*, TextColumn*, CRows*, Worksheet*, FormulaVariableNode*,
                        FormulaModelNode*, FormulaModelVariableNode*, ExpressionError*,
                        xlsxDataProvider*, ExcelXLSXReader*, XmlReader*, CmXmlException*) {}

DPXLSX_API void formatObjects(NumericVariableFormat*, PercentageVariableFormat*,
                              FractionVariableFormat*, TextVariableFormat*, DateTimeVariableFormat*,
                              xStyle*) {}

// What inline functions compiled into hosts read of the cells.
DPXLSX_API void cells(ExternalDataRecord*, WorksheetCells*, CellColumn*,
                      CellColumn::const_iterator*, CellView*, PackedCell*, RareCell*, PooledText*,
                      BlankRows*, SheetReadOptions*, ColumnReadOptions*) {}

}  // namespace dp
