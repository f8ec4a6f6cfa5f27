#pragma once

#include "export.h"

// The host's formula objects. An import brings no formulas, only the values that they had: the
// library hands out an empty manager, and what the numbers in the other objects mean is the host's.
// Indices are 0-based and must be below the matching count, which is not checked. Texts and objects
// returned by pointer belong to the object that was asked and are valid while it lives, neighbours
// of a node excepted.
namespace dp {

// An error in the text of a formula.
class DPXLSX_API IExpressionError {
  public:
    virtual ~IExpressionError() = default;

    // --- What is wrong and where, in the host's numbering; 0 until the maker sets it ---
    virtual int GetCode() const = 0;
    virtual int GetPosition() const = 0;
    virtual int GetLine() const = 0;
    virtual int GetRepeatCount() const = 0;
    virtual int GetLetter() const = 0;
    virtual int GetArgumentCount() const = 0;
};

// A node in the graph of what depends on what.
class DPXLSX_API IFormulaNode {
  public:
    virtual ~IFormulaNode() = default;

    // The node's own key, 0 until one is set.
    virtual int GetPrimeKey() const = 0;
    virtual void SetPrimeKey(int key) = 0;
    // 0 variable, 1 model, 2 model variable: which of the interfaces below the node has.
    virtual int GetType() const = 0;

    // --- As the node's maker set them; false and 0 until then ---
    virtual bool GetDirty() const = 0;
    virtual int GetState() const = 0;

    // --- The neighbours in the graph, which a node does not keep alive ---
    virtual int GetParentNodeCount() const = 0;
    virtual int GetChildNodeCount() const = 0;
    virtual IFormulaNode* GetParentNode(int index) const = 0;
    virtual IFormulaNode* GetChildNode(int index) const = 0;
};

// A variable that a formula computes.
class DPXLSX_API IFormulaVariableNode : public IFormulaNode {
  public:
    // The key of the variable, 0 until one is set.
    virtual int GetVariablePrimeKey() const = 0;
    // The number of pairs that GetVariablePosition returns.
    virtual int GetVariablePositionCount() const = 0;
    // Pair `index` in ascending order of keys. Null pointers are skipped.
    virtual void GetVariablePosition(int index, int* value, int* key) const = 0;
    // The text of the formula, UTF-8; never null.
    virtual const char* GetFormula() const = 0;
    // The number of errors found in that text.
    virtual int GetExpressionErrorCount() const = 0;
    // Error `index`, owned by the node; never null.
    virtual const IExpressionError* GetExpressionError(int index) const = 0;
};

// A model that depends on variables.
class DPXLSX_API IFormulaModelNode : public IFormulaNode {
  public:
    // The keys of the model and of its variable, 0 until set.
    virtual int GetModelPrimeKey() const = 0;
    virtual int GetVariablePrimeKey() const = 0;
    // The terms of the model, UTF-8; never null.
    virtual const char* GetTerms() const = 0;
    // The host's code for the kind of model, 0 until set.
    virtual int GetModelType() const = 0;
};

// A variable of a model.
class DPXLSX_API IFormulaModelVariableNode : public IFormulaNode {
  public:
    // The key of the variable, 0 until one is set.
    virtual int GetVariablePrimeKey() const = 0;
};

// All formulas of a worksheet: none after an import.
class DPXLSX_API IFormulaManager {
  public:
    virtual ~IFormulaManager() = default;

    // --- Always false from an import: there is nothing to compute ---
    virtual bool GetUpdateAutomatically() const = 0;
    virtual bool GetRecalculate() const = 0;
    virtual bool GetStatusUpdateRequired() const = 0;

    // --- Always empty from an import, never null ---
    virtual const char* GetListSeparator() const = 0;
    virtual const char* GetDecimalSymbol() const = 0;

    // Always 0 from an import.
    virtual int GetFormulaNodeCount() const = 0;
    // Node `index`, owned by the manager.
    virtual IFormulaNode* GetFormulaNode(int index) const = 0;
};

}  // namespace dp
