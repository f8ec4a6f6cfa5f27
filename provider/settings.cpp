#include <string>
#include <utility>

#include "dpxlsx/model/string.h"
#include "dpxlsx/provider/excel_data_provider_base.h"

// The settings of one provider.
namespace dp {

void ExcelDataProviderBase::SetWriteOptionVariableNames(bool write) { _writeVariableNames = write; }

void ExcelDataProviderBase::SetMissingText(const char* from, const char* to) {
    // Copied first: the arguments may point into the strings that are replaced, as the getters
    // return them.
    std::string newFrom = textOrEmpty(from);
    std::string newTo = textOrEmpty(to);
    _missingTextFrom = std::move(newFrom);
    _missingTextTo = std::move(newTo);
}

void ExcelDataProviderBase::SetMissingNumeric(double from, double to) {
    _missingNumericFrom = from;
    _missingNumericTo = to;
}

void ExcelDataProviderBase::SetAlphaMissingNumeric(const char* from, double to) {
    _alphaMissingNumericFrom = textOrEmpty(from);
    _missingNumericTo = to;
    _alphaMissingNumericSet = !_alphaMissingNumericFrom.empty();
}

void ExcelDataProviderBase::SetMaxVariableNameLength(unsigned length) {
    _maxVariableNameLength = length;
}

void ExcelDataProviderBase::SetDateTimeVariableFormatHelper(IDateTimeVariableFormat* helper) {
    // The helper that is already set must not be deleted when the host sets it again.
    if (helper != _dateTimeHelper.get()) _dateTimeHelper.reset(helper);
}

IDateTimeVariableFormat* ExcelDataProviderBase::GetDateTimeVariableFormatHelper() const {
    return _dateTimeHelper.get();
}

void ExcelDataProviderBase::SetPreviewing(bool previewing) { _previewing = previewing; }
void ExcelDataProviderBase::SetError(long error) { _error = error; }
long ExcelDataProviderBase::GetError() const { return _error; }

const char* ExcelDataProviderBase::GetMissingTextFrom() const { return _missingTextFrom.c_str(); }
const char* ExcelDataProviderBase::GetMissingTextTo() const { return _missingTextTo.c_str(); }
double ExcelDataProviderBase::GetMissingVxlValue() const { return _missingValue; }

const char* ExcelDataProviderBase::GetAlphaMissingNumericFrom() const {
    return _alphaMissingNumericFrom.c_str();
}

double ExcelDataProviderBase::GetMissingNumericTo() const { return _missingNumericTo; }
double ExcelDataProviderBase::GetMissingNumericFrom() const { return _missingNumericFrom; }
bool ExcelDataProviderBase::GetWriteOptionVariableNames() const { return _writeVariableNames; }
bool ExcelDataProviderBase::IsPreviewing() const { return _previewing; }
int ExcelDataProviderBase::GetPreviewNumberOfRows() const { return 100; }
int ExcelDataProviderBase::GetPreviewNumberOfColumns() const { return 100; }

// Accepted and ignored.
void ExcelDataProviderBase::SetFieldDelimiter(char) {}
void ExcelDataProviderBase::SetTextDelimiter(char) {}
void ExcelDataProviderBase::SetDecimalSeparator(char) {}
void ExcelDataProviderBase::SetReadOptionFoldTextValues(bool) {}
void ExcelDataProviderBase::SetInferFormatPolicy(int) {}
void ExcelDataProviderBase::SetUnitTesting(bool) {}
void ExcelDataProviderBase::SetTestNoTempFile(bool) {}

}  // namespace dp
