#include "dpxlsx/provider/excel_data_provider_base.h"

// Operations of the host's interfaces that an import does not have.
namespace dp {

namespace {

constexpr long kUnsupported = -50;

}  // namespace

long ExcelDataProviderBase::AddWorksheet(IWorksheet*) { return kUnsupported; }
long ExcelDataProviderBase::AddDesign(IDesign*) { return kUnsupported; }
long ExcelDataProviderBase::AddTaguchiDesign(ITaguchiDesign*) { return kUnsupported; }
long ExcelDataProviderBase::AddTaguchiAnalysis(ITaguchiAnalysis*) { return kUnsupported; }
long ExcelDataProviderBase::AddTaguchiPrediction(ITaguchiPrediction*) { return kUnsupported; }
long ExcelDataProviderBase::AddAnalysis(IAnalysis*) { return kUnsupported; }
long ExcelDataProviderBase::AddResponseModels(IResponseModels*) { return kUnsupported; }

long ExcelDataProviderBase::AddVariabilityDataCollection(IVariabilityDataCollection*) {
    return kUnsupported;
}

long ExcelDataProviderBase::AddMultipleResponseOptimization(IMultipleResponseOptimization*) {
    return kUnsupported;
}

long ExcelDataProviderBase::AddMixtureResponseModelCollection(IMixtureResponseModelCollection*) {
    return kUnsupported;
}

long ExcelDataProviderBase::AddColumn(INumericColumn*) { return kUnsupported; }
long ExcelDataProviderBase::AddColumn(ITextColumn*) { return kUnsupported; }
long ExcelDataProviderBase::AddConstant(INumericConstant*) { return kUnsupported; }
long ExcelDataProviderBase::AddConstant(ITextConstant*) { return kUnsupported; }
long ExcelDataProviderBase::AddMatrix(IMatrix*) { return kUnsupported; }
long ExcelDataProviderBase::AddModel(IModel*) { return kUnsupported; }
long ExcelDataProviderBase::AddFactorialPlot(IFactorialPlot*) { return kUnsupported; }
long ExcelDataProviderBase::AddMixturePlot(IMixturePlot*) { return kUnsupported; }
long ExcelDataProviderBase::AddCustomDesign(ICustomDesign*) { return kUnsupported; }
long ExcelDataProviderBase::AddFormulaNode(IFormulaNode*) { return kUnsupported; }
long ExcelDataProviderBase::AddDDELink(IDDELink*) { return kUnsupported; }

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
