#include "dpxlsx/formats/input_decimal.h"
#include "dpxlsx/model/string.h"
#include "dpxlsx/provider/excel_data_provider_base.h"
#include "dpxlsx/store/conversion.h"
#include "dpxlsx/store/number_recognition.h"

namespace dp {

double ExcelDataProviderBase::_missingValue = kInitialMissingValue;
double ExcelDataProviderBase::_minNumericValue = -1.001e18;
double ExcelDataProviderBase::_maxNumericValue = 1.001e18;
double ExcelDataProviderBase::_maxNumericInt = 2147000000.0;
std::int32_t ExcelDataProviderBase::_maxTextLength = 80;
char ExcelDataProviderBase::_inputDecimal = '.';
char ExcelDataProviderBase::_outputDecimal = '.';
char ExcelDataProviderBase::_outputGroupingSymbol = ',';
std::string ExcelDataProviderBase::_missingValueText = "*";
std::string ExcelDataProviderBase::_trueValue = "TRUE";
std::string ExcelDataProviderBase::_falseValue = "FALSE";

void ExcelDataProviderBase::SetMissingValue(double value) { _missingValue = value; }

void ExcelDataProviderBase::SetMissingValueTextRepresentation(const char* text) {
    _missingValueText = textOrEmpty(text);
}

void ExcelDataProviderBase::SetNumericRange(double minimum, double maximum) {
    _minNumericValue = minimum;
    _maxNumericValue = maximum;
}

void ExcelDataProviderBase::SetMaximumTextLength(int length) { _maxTextLength = length; }

void ExcelDataProviderBase::SetInputDecimal(char symbol) { _inputDecimal = symbol; }

void ExcelDataProviderBase::SetOutputDecimal(char symbol) { _outputDecimal = symbol; }

void ExcelDataProviderBase::SetOutputGroupingSymbol(char symbol) { _outputGroupingSymbol = symbol; }

void ExcelDataProviderBase::SetBooleanTrueValue(const char* text) {
    _trueValue = textOrEmpty(text);
}

void ExcelDataProviderBase::SetBooleanFalseValue(const char* text) {
    _falseValue = textOrEmpty(text);
}

double ExcelDataProviderBase::GetMissingValue() { return _missingValue; }

const char* ExcelDataProviderBase::GetMissingValueTextRepresentation() {
    return _missingValueText.c_str();
}

const char* ExcelDataProviderBase::GetBooleanTrueValue() { return _trueValue.c_str(); }
const char* ExcelDataProviderBase::GetBooleanFalseValue() { return _falseValue.c_str(); }
double ExcelDataProviderBase::GetNumericMinimumValue() { return _minNumericValue; }
double ExcelDataProviderBase::GetNumericMaximumValue() { return _maxNumericValue; }
double ExcelDataProviderBase::GetNumericMaximumInt() { return _maxNumericInt; }
int ExcelDataProviderBase::GetMaximumTextLength() { return _maxTextLength; }
char ExcelDataProviderBase::GetInputDecimal() { return _inputDecimal; }
char ExcelDataProviderBase::GetOutputDecimal() { return _outputDecimal; }
char ExcelDataProviderBase::GetOutputGroupingSymbol() { return _outputGroupingSymbol; }

char inputDecimal() noexcept { return ExcelDataProviderBase::_inputDecimal; }

bool IsNumber(const std::string& text, char decimal, double* value) {
    double unasked = 0.0;
    return recogniseNumber(text, decimal, ExcelDataProviderBase::_missingValue,
                           value ? value : &unasked);
}

}  // namespace dp
