#include "dpxlsx/provider/excel_data_provider_base.h"

// Operations of the host's interfaces that an import does not have.
namespace dp {

namespace {

constexpr long kNoOperation = -50;

}  // namespace

long ExcelDataProviderBase::AddWorksheet(IWorksheet*) { return kNoOperation; }
long ExcelDataProviderBase::AddDesign(IDesign*) { return kNoOperation; }
long ExcelDataProviderBase::AddTaguchiDesign(ITaguchiDesign*) { return kNoOperation; }
long ExcelDataProviderBase::AddTaguchiAnalysis(ITaguchiAnalysis*) { return kNoOperation; }
long ExcelDataProviderBase::AddTaguchiPrediction(ITaguchiPrediction*) { return kNoOperation; }
long ExcelDataProviderBase::AddAnalysis(IAnalysis*) { return kNoOperation; }
long ExcelDataProviderBase::AddResponseModels(IResponseModels*) { return kNoOperation; }

long ExcelDataProviderBase::AddVariabilityDataCollection(IVariabilityDataCollection*) {
    return kNoOperation;
}

long ExcelDataProviderBase::AddMultipleResponseOptimization(IMultipleResponseOptimization*) {
    return kNoOperation;
}

long ExcelDataProviderBase::AddMixtureResponseModelCollection(IMixtureResponseModelCollection*) {
    return kNoOperation;
}

long ExcelDataProviderBase::AddColumn(INumericColumn*) { return kNoOperation; }
long ExcelDataProviderBase::AddColumn(ITextColumn*) { return kNoOperation; }
long ExcelDataProviderBase::AddConstant(INumericConstant*) { return kNoOperation; }
long ExcelDataProviderBase::AddConstant(ITextConstant*) { return kNoOperation; }
long ExcelDataProviderBase::AddMatrix(IMatrix*) { return kNoOperation; }
long ExcelDataProviderBase::AddModel(IModel*) { return kNoOperation; }
long ExcelDataProviderBase::AddFactorialPlot(IFactorialPlot*) { return kNoOperation; }
long ExcelDataProviderBase::AddMixturePlot(IMixturePlot*) { return kNoOperation; }
long ExcelDataProviderBase::AddCustomDesign(ICustomDesign*) { return kNoOperation; }
long ExcelDataProviderBase::AddFormulaNode(IFormulaNode*) { return kNoOperation; }
long ExcelDataProviderBase::AddDDELink(IDDELink*) { return kNoOperation; }

IDOEReader* ExcelDataProviderBase::GetDOEReader() { return nullptr; }
long ExcelDataProviderBase::RereadFile() { return -1; }

IReadOnlyCollection<int>* ExcelDataProviderBase::noKeys() const {
    _columnKeys.items.clear();
    return &_columnKeys;
}

IReadOnlyCollection<int>* ExcelDataProviderBase::GetConstantPrimeKeys(int) const {
    return noKeys();
}

IReadOnlyCollection<int>* ExcelDataProviderBase::GetMatrixPrimeKeys(int) const { return noKeys(); }

IReadOnlyCollection<int>* ExcelDataProviderBase::GetModelPrimeKeys(IModel::ModelSubtype,
                                                                   int) const {
    return noKeys();
}

bool ExcelDataProviderBase::FindConstant(int, IConstant**) const { return false; }
bool ExcelDataProviderBase::FindMatrix(int, IMatrix**) const { return false; }
bool ExcelDataProviderBase::FindModel(int, IModel**) const { return false; }

bool ExcelDataProviderBase::FindRegisteredSharedVariableBody(int, IVariable**) const {
    return false;
}

void ExcelDataProviderBase::RegisterSharedVariableBody(int, IVariable*) {}

}  // namespace dp
