#pragma once

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// Display of numbers as fractions of a fixed denominator: 2.5 as "2 2/4" or "10/4". Immutable once
// its maker has set the fields; rendering may run on any thread.
class DPXLSX_API FractionVariableFormat : public IFractionVariableFormat {
  public:
    FractionVariableFormat();
    ~FractionVariableFormat() override;

    FormatType GetType() const override;
    bool GetAuto() const override;
    // A new string: the plain number when full precision is asked for or shown always, empty
    // without a fixed denominator, else the fraction.
    IString* FormatValue(double value, bool fullPrecision) const override;
    NumericSubtype GetNumericSubtype() const override;
    void GetDecimalPlaces(int* places, int* digits) const override;
    void GetValueRange(double* low, double* high) const override;
    bool ShowFullPrecision() const override;
    int GetDenominator() const override;
    int GetMaximumDigits() const override;
    bool GetMixedFraction() const override;
    bool GetFixedDenominator() const override;

    bool autoFormat = false;
    int decimalPlaces = 0;      // decimals of the denominator
    int significantDigits = 0;  // decimals of the numerator; digits of the plain number
    double rangeLow = 0;        // kept for the host, like the next one
    double rangeHigh = 0;
    int denominator = 0;
    int maximumDigits = 0;  // decimals of the whole part
    bool mixedFraction = false;
    bool fixedDenominator = false;
    bool showsFullPrecision = false;
};

}  // namespace dp
