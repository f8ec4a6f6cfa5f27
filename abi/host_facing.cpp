// The classes whose layout hosts rely on, for scripts/check-abi: compiled apart from the library,
// so that the record of them is the same whatever the build.
#include "formats/date_time_variable_format.h"
#include "formats/fraction_variable_format.h"
#include "formats/numeric_variable_format.h"
#include "formats/percentage_variable_format.h"
#include "formats/style.h"
#include "formats/text_variable_format.h"
#include "model/columns.h"
#include "model/formula.h"
#include "model/host/entry_points.h"
#include "model/host/i_finders.h"
#include "model/rows.h"
#include "model/worksheet.h"
#include "provider/xlsx_data_provider.h"
#include "readers/excel_xlsx_reader.h"
#include "readers/xml_reader.h"

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
                              xStyle*, ExternalDataRecord*) {}

}  // namespace dp
