#pragma once

#include "model/host/export.h"

namespace dp {

// What a column is to the host's variable manager: keys, place and origin.
class DPXLSX_API IVariable {
  public:
    enum class StorageType : int { Numeric = 0, Text = 1 };
    // The kind that a column read option asks for.
    enum class BasicDataType : int { NotSet = 0, Numeric = 1, Text = 2, DateTime = 3 };

    virtual ~IVariable() = default;

    virtual int GetPrimeKey() const = 0;
    virtual void SetPrimeKey(int key) = 0;
    virtual int GetVariableBodyPrimeKey() const = 0;
    virtual void SetVariableBodyPrimeKey(int key) = 0;
    virtual int GetOriginalVariablePrimeKey() const = 0;
    virtual void SetOriginalVariablePrimeKey(int key) = 0;
    virtual bool UseDefaultVariableBody() const = 0;
    // The host's code for the kind of variable; 3 for a column.
    virtual int GetType() const = 0;
    // 1-based place in the worksheet.
    virtual int GetPosition() const = 0;
    virtual int GetWorksheetId() const = 0;
    virtual bool Attached() const = 0;
    virtual bool IsCopy() const = 0;
};

}  // namespace dp
