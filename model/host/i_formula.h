#pragma once

#include "model/host/export.h"

// The host's formula objects. An import brings no formulas, so the plug-in only hands out an empty
// manager. Index arguments must be below the matching count. Texts belong to the object.
namespace dp {

class DPXLSX_API IExpressionError {
  public:
    virtual ~IExpressionError() = default;

    virtual int GetCode() const = 0;
    virtual int GetPosition() const = 0;
    virtual int GetLine() const = 0;
    virtual int GetRepeatCount() const = 0;
    virtual int GetLetter() const = 0;
    virtual int GetArgumentCount() const = 0;
};

class DPXLSX_API IFormulaNode {
  public:
    virtual ~IFormulaNode() = default;

    virtual int GetPrimeKey() const = 0;
    virtual void SetPrimeKey(int key) = 0;
    // 0 variable, 1 model, 2 model variable.
    virtual int GetType() const = 0;
    virtual bool GetDirty() const = 0;
    virtual int GetState() const = 0;
    virtual int GetParentNodeCount() const = 0;
    virtual int GetChildNodeCount() const = 0;
    virtual IFormulaNode* GetParentNode(int index) const = 0;
    virtual IFormulaNode* GetChildNode(int index) const = 0;
};

class DPXLSX_API IFormulaVariableNode : public IFormulaNode {
  public:
    virtual int GetVariablePrimeKey() const = 0;
    virtual int GetVariablePositionCount() const = 0;
    // Entry `index` in ascending key order. Null pointers are skipped.
    virtual void GetVariablePosition(int index, int* value, int* key) const = 0;
    virtual const char* GetFormula() const = 0;
    virtual int GetExpressionErrorCount() const = 0;
    virtual const IExpressionError* GetExpressionError(int index) const = 0;
};

class DPXLSX_API IFormulaModelNode : public IFormulaNode {
  public:
    virtual int GetModelPrimeKey() const = 0;
    virtual int GetVariablePrimeKey() const = 0;
    virtual const char* GetTerms() const = 0;
    virtual int GetModelType() const = 0;
};

class DPXLSX_API IFormulaModelVariableNode : public IFormulaNode {
  public:
    virtual int GetVariablePrimeKey() const = 0;
};

class DPXLSX_API IFormulaManager {
  public:
    virtual ~IFormulaManager() = default;

    virtual bool GetUpdateAutomatically() const = 0;
    virtual bool GetRecalculate() const = 0;
    virtual bool GetStatusUpdateRequired() const = 0;
    virtual const char* GetListSeparator() const = 0;
    virtual const char* GetDecimalSymbol() const = 0;
    virtual int GetFormulaNodeCount() const = 0;
    // Owned by the manager.
    virtual IFormulaNode* GetFormulaNode(int index) const = 0;
};

}  // namespace dp
