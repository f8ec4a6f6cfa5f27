#include "dpxlsx/provider/excel_data_provider_base.h"

#include "dpxlsx/model/reference_count.h"
#include "dpxlsx/store/conversion.h"

// Construction, reference counting and destruction of the provider.
namespace dp {

ExcelDataProviderBase::ExcelDataProviderBase() { ResetInternalData(); }

ExcelDataProviderBase::~ExcelDataProviderBase() = default;

unsigned ExcelDataProviderBase::AddRef() { return ++_refCount; }

void ExcelDataProviderBase::Release() {
    if (releaseReference(_refCount)) delete this;
}

void ExcelDataProviderBase::ClearWorksheets() { ResetInternalData(); }

void ExcelDataProviderBase::ResetInternalData() {
    _previewing = false;
    _worksheetIndex = -1;
    _worksheetColumns.clear();
    _worksheetNames.clear();
    _cells.clear();
    _columnKeys.items.clear();
    _allWorksheetKeys.items.clear();
    _worksheetKeys.items.clear();
    _writeVariableNames = true;
    // Whatever SetMissingValue has set since.
    _missingNumericFrom = kInitialMissingValue;
    _missingNumericTo = kInitialMissingValue;
    _alphaMissingNumericSet = false;
    _sheetReadOptions.clear();
    _ignoreBlankRows = false;
    _blankRows.clear();
    _padColumnsWithMissing = false;
    _lastRows.clear();
    _cleanTextValues = false;
    _cleanWorksheetNames = false;
    _convertDateTimeToText = false;
    _columnReadOptions.clear();
    _maxVariableNameLength = kNotSet;
    _error = 0;
    _defaultVariableNameRowSetting = EVariableNameRowSetting{kNotSet};
}

IWorksheetFinder* ExcelDataProviderBase::GetWorksheetFinder() { return this; }
IVariableFinder* ExcelDataProviderBase::GetVariableFinder() { return this; }
std::string ExcelDataProviderBase::GetTempDirectoryPath() const { return {}; }
std::string ExcelDataProviderBase::GetFileName() const { return _fileName; }

}  // namespace dp
