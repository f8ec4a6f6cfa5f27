#pragma once

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// Automatic, fixed-decimal and scientific display of numbers. Immutable once its maker has set the
// fields; rendering may run on any thread.
class DPXLSX_API NumericVariableFormat : public INumericVariableFormat {
  public:
    NumericVariableFormat();
    ~NumericVariableFormat() override;

    FormatType GetType() const override;
    bool GetAuto() const override;
    // A new string: in scientific or fixed notation, or with as many digits as the value needs.
    // With `fullPrecision` the decimal places do not count.
    IString* FormatValue(double value, bool fullPrecision) const override;
    NumericSubtype GetNumericSubtype() const override;
    void GetDecimalPlaces(int* places, int* digits) const override;
    void GetValueRange(double* low, double* high) const override;
    bool ShowFullPrecision() const override;

    bool autoFormat = false;
    int decimalPlaces = 0;      // 0 in scientific notation: as many as the value needs
    int significantDigits = 0;  // kept for the host, like the next three
    double rangeLow = 0;
    double rangeHigh = 0;
    bool showsFullPrecision = false;
    NumericSubtype numericSubtype = NumericSubtype::General;
};

}  // namespace dp
