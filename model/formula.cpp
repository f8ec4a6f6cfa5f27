#include "model/formula.h"

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

IFormulaNode* FormulaNode::GetParentNode(int index) const { return itemAt(parentNodes, index); }

IFormulaNode* FormulaNode::GetChildNode(int index) const { return itemAt(childNodes, index); }

void FormulaVariableNode::GetVariablePosition(int index, int* value, int* key) const {
    assert(index >= 0 && static_cast<std::size_t>(index) < variablePositions.size());
    const auto entry = std::next(variablePositions.begin(), index);
    if (value) *value = entry->second;
    if (key) *key = entry->first;
}

const IExpressionError* FormulaVariableNode::GetExpressionError(int index) const {
    return &itemAt(expressionErrors, index);
}

FormulaManager::~FormulaManager() {
    for (FormulaNode* node : formulaNodes) delete node;
}

IFormulaNode* FormulaManager::GetFormulaNode(int index) const {
    return itemAt(formulaNodes, index)->GetFormulaNodeInterface();
}

}  // namespace dp
