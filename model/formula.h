#pragma once

#include <map>
#include <memory>
#include <vector>

#include "model/host/i_formula.h"
#include "model/string.h"

// The formula objects of the host's model. An import fills none of them. Field and slot order are
// part of the binary contract.
namespace dp {

class DPXLSX_API ExpressionError : public IExpressionError {
  public:
    ExpressionError() = default;
    ExpressionError(const ExpressionError&) = default;
    ExpressionError& operator=(const ExpressionError&) = default;

    int GetCode() const override { return code; }
    int GetPosition() const override { return position; }
    int GetLine() const override { return line; }
    int GetRepeatCount() const override { return repeatCount; }
    int GetLetter() const override { return letter; }
    int GetArgumentCount() const override { return argumentCount; }

    int code = 0;
    int argumentCount = 0;
    int letter = 0;
    int line = 0;
    int position = 0;
    int repeatCount = 0;
};

// What all nodes share. Parents and children are borrowed: a node's copy points to the same ones.
class DPXLSX_API FormulaNode : public IFormulaNode {
  public:
    int GetPrimeKey() const override { return primeKey; }
    void SetPrimeKey(int key) override { primeKey = key; }
    bool GetDirty() const override { return dirty; }
    int GetState() const override { return state; }
    int GetParentNodeCount() const override { return static_cast<int>(parentNodes.size()); }
    int GetChildNodeCount() const override { return static_cast<int>(childNodes.size()); }
    IFormulaNode* GetParentNode(int index) const override;
    IFormulaNode* GetChildNode(int index) const override;

    virtual void SetParentNode(IFormulaNode* node) { parentNodes.push_back(node); }
    virtual void SetChildNode(IFormulaNode* node) { childNodes.push_back(node); }
    // This node through the interface of its own kind.
    virtual IFormulaNode* GetFormulaNodeInterface() = 0;

    int primeKey = 0;
    bool dirty = false;
    int state = 0;
    std::vector<IFormulaNode*> parentNodes;
    std::vector<IFormulaNode*> childNodes;
};

// A node that the host reaches through FormulaNode and through the interface of its kind: answers
// the shared questions once for both.
template <class Interface, int kType>
class DPXLSX_API FormulaNodeOf : public FormulaNode, public Interface {
  public:
    int GetPrimeKey() const override { return FormulaNode::GetPrimeKey(); }
    void SetPrimeKey(int key) override { FormulaNode::SetPrimeKey(key); }
    int GetType() const override { return kType; }
    bool GetDirty() const override { return FormulaNode::GetDirty(); }
    int GetState() const override { return FormulaNode::GetState(); }
    int GetParentNodeCount() const override { return FormulaNode::GetParentNodeCount(); }
    int GetChildNodeCount() const override { return FormulaNode::GetChildNodeCount(); }
    IFormulaNode* GetParentNode(int index) const override {
        return FormulaNode::GetParentNode(index);
    }
    IFormulaNode* GetChildNode(int index) const override {
        return FormulaNode::GetChildNode(index);
    }
    IFormulaNode* GetFormulaNodeInterface() override { return static_cast<Interface*>(this); }
};

class DPXLSX_API FormulaVariableNode : public FormulaNodeOf<IFormulaVariableNode, 0> {
  public:
    int GetVariablePrimeKey() const override { return variablePrimeKey; }
    int GetVariablePositionCount() const override {
        return static_cast<int>(variablePositions.size());
    }
    void GetVariablePosition(int index, int* value, int* key) const override;
    const char* GetFormula() const override { return formula.database_str(); }
    int GetExpressionErrorCount() const override {
        return static_cast<int>(expressionErrors.size());
    }
    const IExpressionError* GetExpressionError(int index) const override;

    std::map<int, int> variablePositions;
    std::vector<ExpressionError> expressionErrors;
    int variablePrimeKey = 0;
    String formula;
};

class DPXLSX_API FormulaModelNode : public FormulaNodeOf<IFormulaModelNode, 1> {
  public:
    int GetModelPrimeKey() const override { return modelPrimeKey; }
    int GetVariablePrimeKey() const override { return variablePrimeKey; }
    const char* GetTerms() const override { return terms.database_str(); }
    int GetModelType() const override { return modelType; }

    int variablePrimeKey = 0;
    int modelPrimeKey = 0;
    String terms;
    int modelType = 0;
};

class DPXLSX_API FormulaModelVariableNode : public FormulaNodeOf<IFormulaModelVariableNode, 2> {
  public:
    int GetVariablePrimeKey() const override { return variablePrimeKey; }

    int variablePrimeKey = 0;
};

class DPXLSX_API FormulaManager : public IFormulaManager {
  public:
    FormulaManager() = default;
    FormulaManager(const FormulaManager&) = delete;
    FormulaManager& operator=(const FormulaManager&) = delete;
    ~FormulaManager() override;

    bool GetUpdateAutomatically() const override { return updateAutomatically; }
    bool GetRecalculate() const override { return recalculate; }
    bool GetStatusUpdateRequired() const override { return statusUpdateRequired; }
    const char* GetListSeparator() const override { return listSeparator.database_str(); }
    const char* GetDecimalSymbol() const override { return decimalSymbol.database_str(); }
    int GetFormulaNodeCount() const override { return static_cast<int>(formulaNodes.size()); }
    IFormulaNode* GetFormulaNode(int index) const override;

    bool updateAutomatically = false;
    bool recalculate = false;
    bool statusUpdateRequired = false;
    String listSeparator;
    String decimalSymbol;
    std::vector<FormulaNode*> formulaNodes;  // owned
};

}  // namespace dp
