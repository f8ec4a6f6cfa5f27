#pragma once

#include "model/host/export.h"
#include "model/host/i_read_only_collection.h"
#include "model/host/i_resource.h"
#include "model/host/i_variable.h"

// The columns that a provider makes. What a getter returns by pointer belongs to the column and is
// valid while the column lives.
namespace dp {

class IString;
class IVariableFormat;

class DPXLSX_API IColumnView {
  public:
    virtual ~IColumnView() = default;

    virtual bool GetAutoWiden() const = 0;
    virtual bool GetWidthSet() const = 0;
    virtual bool GetHidden() const = 0;
    virtual double GetWidth() const = 0;
};

class DPXLSX_API IColumnOrdering {
  public:
    virtual ~IColumnOrdering() = default;

    virtual int GetValueOrder() const = 0;
    virtual const IReadOnlyCollection<IString&>* GetOrderedTextValues() const = 0;
};

class DPXLSX_API IColumn : public IResource, public IVariable {
  public:
    // 0 numbers, 2 date-times, 4 texts.
    virtual int GetDataType() const = 0;
    virtual StorageType GetStorageType() const = 0;
    virtual const IString* GetName() const = 0;
    virtual const IString* GetDescription() const = 0;
    virtual int GetLastModified() const = 0;
    // Rows without a cell, or with one that did not convert.
    virtual int GetMissingCount() const = 0;
    virtual int GetRowCount() const = 0;
    // Null for a column that was not loaded from a worksheet.
    virtual IVariableFormat* GetFormat() const = 0;
    virtual const IColumnView* GetView() const = 0;
    virtual bool IsFormatDirty() const = 0;
};

class DPXLSX_API INumericColumn : public IColumn {
  public:
    // GetRowCount() numbers, the provider's missing value where a row has none.
    virtual const double* GetValues() const = 0;
    // Cells that had content but became missing on conversion. Error cells are no cells here.
    virtual int GetConvertedMissingCount() const = 0;
    // `value` by the column's format without the format's own decimal places, which may lose
    // digits, with `decimal` as decimal symbol (ignored by date-times); FormatValue(value, false)
    // of the format has them. A new string owned by the caller; null for a column without a format.
    virtual IString* GetFormattedValue(double value, char decimal) const = 0;
};

class DPXLSX_API ITextColumn : public IColumn {
  public:
    // GetRowCount() texts, empty where a row has none.
    virtual const IReadOnlyCollection<IString&>* GetTextValues() const = 0;
    virtual const IColumnOrdering* GetOrdering() const = 0;
};

}  // namespace dp
