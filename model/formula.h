#pragma once

#include <map>
#include <vector>

#include "dpxlsx/model/host/i_formula.h"
#include "dpxlsx/model/string.h"

// The formula objects of the host's model. An import fills none of them. A getter returns the
// field of its name; whoever makes the object fills the fields. Field and slot order are part of
// the binary contract.
namespace dp {

class DPXLSX_API ExpressionError : public IExpressionError {
  public:
    ExpressionError();
    ExpressionError(const ExpressionError& other);
    ExpressionError& operator=(const ExpressionError& other);
    ~ExpressionError() override;

    int GetCode() const override;
    int GetPosition() const override;
    int GetLine() const override;
    int GetRepeatCount() const override;
    int GetLetter() const override;
    int GetArgumentCount() const override;

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
    FormulaNode();
    FormulaNode(const FormulaNode& other);
    FormulaNode& operator=(const FormulaNode& other);
    ~FormulaNode() override;

    int GetPrimeKey() const override;
    void SetPrimeKey(int key) override;
    bool GetDirty() const override;
    int GetState() const override;
    int GetParentNodeCount() const override;
    int GetChildNodeCount() const override;
    IFormulaNode* GetParentNode(int index) const override;
    IFormulaNode* GetChildNode(int index) const override;

    // Appends to the parents; the node is borrowed.
    virtual void SetParentNode(IFormulaNode* node);
    // Appends to the children; the node is borrowed.
    virtual void SetChildNode(IFormulaNode* node);
    // This node through the interface of its own kind.
    virtual IFormulaNode* GetFormulaNodeInterface() = 0;

    int primeKey = 0;
    bool dirty = false;
    int state = 0;
    std::vector<IFormulaNode*> parentNodes;
    std::vector<IFormulaNode*> childNodes;
};

// A node that the host reaches through FormulaNode and through the interface of its kind.
// Implements once, for both bases, the operations that they have in common.
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

extern template class FormulaNodeOf<IFormulaVariableNode, 0>;
extern template class FormulaNodeOf<IFormulaModelNode, 1>;
extern template class FormulaNodeOf<IFormulaModelVariableNode, 2>;

class DPXLSX_API FormulaVariableNode : public FormulaNodeOf<IFormulaVariableNode, 0> {
  public:
    FormulaVariableNode();
    FormulaVariableNode(const FormulaVariableNode& other);
    FormulaVariableNode& operator=(const FormulaVariableNode& other);
    ~FormulaVariableNode() override;

    int GetVariablePrimeKey() const override;
    int GetVariablePositionCount() const override;
    void GetVariablePosition(int index, int* value, int* key) const override;
    const char* GetFormula() const override;
    int GetExpressionErrorCount() const override;
    const IExpressionError* GetExpressionError(int index) const override;

    std::map<int, int> variablePositions;  // value by key
    std::vector<ExpressionError> expressionErrors;
    int variablePrimeKey = 0;
    String formula;
};

class DPXLSX_API FormulaModelNode : public FormulaNodeOf<IFormulaModelNode, 1> {
  public:
    FormulaModelNode();
    FormulaModelNode(const FormulaModelNode& other);
    FormulaModelNode& operator=(const FormulaModelNode& other);
    ~FormulaModelNode() override;

    int GetModelPrimeKey() const override;
    int GetVariablePrimeKey() const override;
    const char* GetTerms() const override;
    int GetModelType() const override;

    int variablePrimeKey = 0;
    int modelPrimeKey = 0;
    String terms;
    int modelType = 0;
};

class DPXLSX_API FormulaModelVariableNode : public FormulaNodeOf<IFormulaModelVariableNode, 2> {
  public:
    FormulaModelVariableNode();
    FormulaModelVariableNode(const FormulaModelVariableNode& other);
    FormulaModelVariableNode& operator=(const FormulaModelVariableNode& other);
    ~FormulaModelVariableNode() override;

    int GetVariablePrimeKey() const override;

    int variablePrimeKey = 0;
};

// Owns its nodes.
class DPXLSX_API FormulaManager : public IFormulaManager {
  public:
    FormulaManager();
    FormulaManager(const FormulaManager&) = delete;
    FormulaManager& operator=(const FormulaManager&) = delete;
    ~FormulaManager() override;

    bool GetUpdateAutomatically() const override;
    bool GetRecalculate() const override;
    bool GetStatusUpdateRequired() const override;
    const char* GetListSeparator() const override;
    const char* GetDecimalSymbol() const override;
    int GetFormulaNodeCount() const override;
    IFormulaNode* GetFormulaNode(int index) const override;

    bool updateAutomatically = false;
    bool recalculate = false;
    bool statusUpdateRequired = false;
    String listSeparator;
    String decimalSymbol;
    std::vector<FormulaNode*> formulaNodes;  // owned
};

}  // namespace dp
