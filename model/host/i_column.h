#pragma once

#include "export.h"
#include "i_read_only_collection.h"
#include "i_resource.h"
#include "i_variable.h"

// The columns that a provider makes. A loaded column depends on neither the provider nor the file
// any more. What a getter returns by pointer belongs to the column, is valid while the column lives
// and never null in a loaded column.
namespace dp {

class IString;
class IVariableFormat;

// How a column is shown. An import reads no widths and no hidden columns: its answers are fixed.
class DPXLSX_API IColumnView {
  public:
    virtual ~IColumnView() = default;

    // Always true: the host may widen the column to its values.
    virtual bool GetAutoWiden() const = 0;
    // Always false: GetWidth() holds no width.
    virtual bool GetWidthSet() const = 0;
    // Always false, also for a column that the workbook hides.
    virtual bool GetHidden() const = 0;
    // Always 0.
    virtual double GetWidth() const = 0;
};

// How the values of a text column are ordered. An import brings no order.
class DPXLSX_API IColumnOrdering {
  public:
    virtual ~IColumnOrdering() = default;

    // The host's code for the order; always 0.
    virtual int GetValueOrder() const = 0;
    // Always empty, never null.
    virtual const IReadOnlyCollection<IString&>* GetOrderedTextValues() const = 0;
};

// What numeric and text columns have in common. GetStorageType() tells which of the two a column
// is.
class DPXLSX_API IColumn : public IResource, public IVariable {
  public:
    // What the values are: 0 numbers, 2 date-times, 4 texts.
    virtual int GetDataType() const = 0;
    // Numeric for an INumericColumn, Text for an ITextColumn.
    virtual StorageType GetStorageType() const = 0;
    // The variable's name, from a column option or from the sheet, empty without one; two columns
    // may share it. Line feeds became spaces; ' and #, a leading * and control characters "_".
    virtual const IString* GetName() const = 0;
    // Always empty.
    virtual const IString* GetDescription() const = 0;
    // Always 0.
    virtual int GetLastModified() const = 0;
    // Rows without a cell, also where SetMissingNumeric or SetMissingText put a value, and rows
    // whose cell gave the missing value or the empty text.
    virtual int GetMissingCount() const = 0;
    // Rows from the first data row to the column's last cell, with padding to the worksheet's last
    // row; fewer where read options leave rows out.
    virtual int GetRowCount() const = 0;
    // How the values are shown; for numbers and date-times by the style of their first cell with a
    // value. Null in a column that was not loaded.
    virtual IVariableFormat* GetFormat() const = 0;
    // How the column is laid out.
    virtual const IColumnView* GetView() const = 0;
    // Always true for a loaded column.
    virtual bool IsFormatDirty() const = 0;
};

// A column of numbers or date-times; date-times are serial day numbers as IDateTimeVariableFormat
// describes them.
class DPXLSX_API INumericColumn : public IColumn {
  public:
    // GetRowCount() numbers; where a row has none, the missing value that was set at the load.
    virtual const double* GetValues() const = 0;
    // The number of cells whose content the column cannot hold: texts that are no number, or no
    // date-time in a column of date-times; numbers that are out of range or that the helper refuses
    // as date-times; date-times where SetReadOptionConvertDateTimeToText asks for texts. Such a
    // cell counts even if SetMissingNumeric or SetAlphaMissingNumeric gives it a number. A cell
    // that one of the two makes missing counts unless the missing value is in range, which by
    // default it is not. Error cells do not count: they are not read.
    virtual int GetConvertedMissingCount() const = 0;
    // A number by the column's format without the format's own decimal places, which may lose
    // digits (FormatValue(value, false) of the format keeps them); the decimal point of the
    // environment's locale becomes `decimal` in it. A date-time as the format shows it, whatever
    // `decimal`. A new string owned by the caller; null for a column without a format.
    virtual IString* GetFormattedValue(double value, char decimal) const = 0;
};

// A column of texts.
class DPXLSX_API ITextColumn : public IColumn {
  public:
    // GetRowCount() texts of at most SetMaximumTextLength bytes; empty where a row has none, unless
    // SetMissingText replaces the empty text.
    virtual const IReadOnlyCollection<IString&>* GetTextValues() const = 0;
    // How the texts are ordered.
    virtual const IColumnOrdering* GetOrdering() const = 0;
};

}  // namespace dp
