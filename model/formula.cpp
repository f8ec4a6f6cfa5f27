#include "dpxlsx/model/formula.h"

#include <cassert>
#include <cstddef>
#include <iterator>

namespace dp {

namespace {

template <class Items>
auto& itemAt(Items& items, int index) {
    assert(index >= 0 && static_cast<std::size_t>(index) < items.size());
    return items[static_cast<std::size_t>(index)];
}

}  // namespace

ExpressionError::ExpressionError() = default;
ExpressionError::ExpressionError(const ExpressionError&) = default;
ExpressionError& ExpressionError::operator=(const ExpressionError&) = default;
ExpressionError::~ExpressionError() = default;

int ExpressionError::GetCode() const { return code; }
int ExpressionError::GetPosition() const { return position; }
int ExpressionError::GetLine() const { return line; }
int ExpressionError::GetRepeatCount() const { return repeatCount; }
int ExpressionError::GetLetter() const { return letter; }
int ExpressionError::GetArgumentCount() const { return argumentCount; }

FormulaNode::FormulaNode() = default;
FormulaNode::FormulaNode(const FormulaNode&) = default;
FormulaNode& FormulaNode::operator=(const FormulaNode&) = default;
FormulaNode::~FormulaNode() = default;

int FormulaNode::GetPrimeKey() const { return primeKey; }
void FormulaNode::SetPrimeKey(int key) { primeKey = key; }
bool FormulaNode::GetDirty() const { return dirty; }
int FormulaNode::GetState() const { return state; }
int FormulaNode::GetParentNodeCount() const { return static_cast<int>(parentNodes.size()); }
int FormulaNode::GetChildNodeCount() const { return static_cast<int>(childNodes.size()); }
void FormulaNode::SetParentNode(IFormulaNode* node) { parentNodes.push_back(node); }
void FormulaNode::SetChildNode(IFormulaNode* node) { childNodes.push_back(node); }

IFormulaNode* FormulaNode::GetParentNode(int index) const { return itemAt(parentNodes, index); }

IFormulaNode* FormulaNode::GetChildNode(int index) const { return itemAt(childNodes, index); }

template class FormulaNodeOf<IFormulaVariableNode, 0>;
template class FormulaNodeOf<IFormulaModelNode, 1>;
template class FormulaNodeOf<IFormulaModelVariableNode, 2>;

FormulaVariableNode::FormulaVariableNode() = default;
FormulaVariableNode::FormulaVariableNode(const FormulaVariableNode&) = default;
FormulaVariableNode& FormulaVariableNode::operator=(const FormulaVariableNode&) = default;
FormulaVariableNode::~FormulaVariableNode() = default;

int FormulaVariableNode::GetVariablePrimeKey() const { return variablePrimeKey; }
int FormulaVariableNode::GetVariablePositionCount() const {
    return static_cast<int>(variablePositions.size());
}
const char* FormulaVariableNode::GetFormula() const { return formula.database_str(); }
int FormulaVariableNode::GetExpressionErrorCount() const {
    return static_cast<int>(expressionErrors.size());
}

void FormulaVariableNode::GetVariablePosition(int index, int* value, int* key) const {
    assert(index >= 0 && static_cast<std::size_t>(index) < variablePositions.size());
    const auto entry = std::next(variablePositions.begin(), index);
    if (value) *value = entry->second;
    if (key) *key = entry->first;
}

const IExpressionError* FormulaVariableNode::GetExpressionError(int index) const {
    return &itemAt(expressionErrors, index);
}

FormulaModelNode::FormulaModelNode() = default;
FormulaModelNode::FormulaModelNode(const FormulaModelNode&) = default;
FormulaModelNode& FormulaModelNode::operator=(const FormulaModelNode&) = default;
FormulaModelNode::~FormulaModelNode() = default;

int FormulaModelNode::GetModelPrimeKey() const { return modelPrimeKey; }
int FormulaModelNode::GetVariablePrimeKey() const { return variablePrimeKey; }
const char* FormulaModelNode::GetTerms() const { return terms.database_str(); }
int FormulaModelNode::GetModelType() const { return modelType; }

FormulaModelVariableNode::FormulaModelVariableNode() = default;
FormulaModelVariableNode::FormulaModelVariableNode(const FormulaModelVariableNode&) = default;
FormulaModelVariableNode& FormulaModelVariableNode::operator=(const FormulaModelVariableNode&) =
    default;
FormulaModelVariableNode::~FormulaModelVariableNode() = default;

int FormulaModelVariableNode::GetVariablePrimeKey() const { return variablePrimeKey; }

FormulaManager::FormulaManager() = default;

FormulaManager::~FormulaManager() {
    for (FormulaNode* node : formulaNodes) delete node;
}

IFormulaNode* FormulaManager::GetFormulaNode(int index) const {
    return itemAt(formulaNodes, index)->GetFormulaNodeInterface();
}

bool FormulaManager::GetUpdateAutomatically() const { return updateAutomatically; }
bool FormulaManager::GetRecalculate() const { return recalculate; }
bool FormulaManager::GetStatusUpdateRequired() const { return statusUpdateRequired; }
const char* FormulaManager::GetListSeparator() const { return listSeparator.database_str(); }
const char* FormulaManager::GetDecimalSymbol() const { return decimalSymbol.database_str(); }
int FormulaManager::GetFormulaNodeCount() const { return static_cast<int>(formulaNodes.size()); }

}  // namespace dp
