#pragma once

#include "export.h"

namespace dp {

// What a column is to the host's variable manager: keys, place and origin. The Set operations
// change this object only; the provider does not learn of them.
class DPXLSX_API IVariable {
  public:
    // How values are kept: one double a row, for numbers and date-times, or one text a row.
    enum class StorageType : int { Numeric = 0, Text = 1 };
    // The kind that a column read option asks for; NotSet leaves it to the first data cell.
    enum class BasicDataType : int { NotSet = 0, Numeric = 1, Text = 2, DateTime = 3 };

    virtual ~IVariable() = default;

    // The key by which FindColumn found the column; 0 in a column that was not loaded.
    virtual int GetPrimeKey() const = 0;
    virtual void SetPrimeKey(int key) = 0;
    // The key of the values; a loaded column has its prime key here.
    virtual int GetVariableBodyPrimeKey() const = 0;
    virtual void SetVariableBodyPrimeKey(int key) = 0;
    // The key of the variable that this one copies; 0 until the host sets one.
    virtual int GetOriginalVariablePrimeKey() const = 0;
    virtual void SetOriginalVariablePrimeKey(int key) = 0;
    // False for a loaded column, which has a key; later SetPrimeKey calls do not change it.
    virtual bool UseDefaultVariableBody() const = 0;
    // The host's code for the kind of variable; 3 for a column.
    virtual int GetType() const = 0;
    // 1-based place in the worksheet: 1 for column A, or the destination id of a column option.
    virtual int GetPosition() const = 0;
    // Always 0 from an import: the host knows from which worksheet it took the column's key.
    virtual int GetWorksheetId() const = 0;
    // Always true from an import.
    virtual bool Attached() const = 0;
    // Always false from an import.
    virtual bool IsCopy() const = 0;
};

}  // namespace dp
