#pragma once

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// Display of numbers as percentages: 0.1234 as "12.34%". Immutable once its maker has set the
// fields; rendering may run on any thread.
class DPXLSX_API PercentageVariableFormat : public IPercentageVariableFormat {
  public:
    PercentageVariableFormat();
    ~PercentageVariableFormat() override;

    FormatType GetType() const override;
    bool GetAuto() const override;
    // The percentage in fixed notation, or with `significantDigits` digits when full precision is
    // asked for or shown always; a new string.
    IString* FormatValue(double value, bool fullPrecision) const override;
    NumericSubtype GetNumericSubtype() const override;
    void GetDecimalPlaces(int* places, int* digits) const override;
    void GetValueRange(double* low, double* high) const override;
    bool ShowFullPrecision() const override;
    int GetDecimalPlaces() const override;

    bool autoFormat = false;
    int decimalPlaces = 0;      // kept for the host, like the range
    int significantDigits = 0;  // with full precision; 0 counts as 1
    double rangeLow = 0;
    double rangeHigh = 0;
    int percentDecimalPlaces = 0;  // of the percentage itself: 2 for "12.34%"
    bool showsFullPrecision = false;
    NumericSubtype numericSubtype = NumericSubtype::Percentage;
};

}  // namespace dp
