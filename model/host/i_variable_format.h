#pragma once

#include "model/host/export.h"

// How the values of a column are shown. A format is a plain heap object: whoever holds it deletes
// it. Texts that an operation makes are new objects owned by the caller; texts that a getter
// returns belong to the format. Out-pointers may be null where an operation says so.
namespace dp {

class IString;

enum class NumericSubtype : int {
    General = 0,
    Fixed = 1,
    Scientific = 2,
    Percentage = 4,
    Fraction = 5
};

class DPXLSX_API IVariableFormat {
  public:
    enum class FormatType : int { Numeric = 0, DateTime = 1, Text = 2 };

    virtual ~IVariableFormat() = default;

    virtual FormatType GetType() const = 0;
    // True when the host may choose the display itself.
    virtual bool GetAuto() const = 0;
    // The display text of `value`, a new string. `fullPrecision` asks for the value without the
    // format's own decimal places.
    virtual IString* FormatValue(double value, bool fullPrecision) const = 0;
};

class DPXLSX_API INumericVariableFormat : public IVariableFormat {
  public:
    virtual NumericSubtype GetNumericSubtype() const = 0;
    // Null pointers are skipped.
    virtual void GetDecimalPlaces(int* decimalPlaces, int* significantDigits) const = 0;
    // Null pointers are skipped.
    virtual void GetValueRange(double* low, double* high) const = 0;
    virtual bool ShowFullPrecision() const = 0;
};

class DPXLSX_API IPercentageVariableFormat : public INumericVariableFormat {
  public:
    using INumericVariableFormat::GetDecimalPlaces;
    // Decimals of the percentage itself: 2 for "12.34%".
    virtual int GetDecimalPlaces() const = 0;
};

class DPXLSX_API IFractionVariableFormat : public INumericVariableFormat {
  public:
    virtual int GetDenominator() const = 0;
    virtual int GetMaximumDigits() const = 0;
    // True for "2 2/4", false for "10/4".
    virtual bool GetMixedFraction() const = 0;
    virtual bool GetFixedDenominator() const = 0;
};

class DPXLSX_API ITextVariableFormat : public IVariableFormat {
  public:
    // Length of the column's longest text in bytes, at least 1 for a loaded column.
    virtual int GetCharacterCount() const = 0;
};

// Date-times are serial day numbers of the 1900 system: 1 is 1900-01-01, 25569 is 1970-01-01, 60 is
// the day 1900-02-29 that never was; the fraction is the time of day. The host gives the provider
// an implementation of its own to convert and check date-times; the plug-in's own formats answer
// those operations neutrally.
class DPXLSX_API IDateTimeVariableFormat : public IVariableFormat {
  public:
    // Four numbers whose meaning is the host's. Null pointers are skipped.
    virtual void GetDateTimeParameters(unsigned* p1, unsigned* p2, unsigned* p3,
                                       unsigned* p4) const = 0;
    // Takes over the four parameters of `other`.
    virtual void SetDateTimeParameters(const IDateTimeVariableFormat* other) = 0;
    // The ICU date pattern, empty for ICU's medium date style. Owned by the format.
    virtual const IString* GetFormatString() const = 0;
    // Reads `text` by the pattern `format` (null: no pattern known). On failure returns false and
    // leaves `value` as it was.
    virtual bool ConvertToDatetime(const IString* format, IString* text, double& value) const = 0;
    // The serial day number of a calendar time.
    virtual double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                                int millisecond) const = 0;
    virtual void SetGlobalDateTimeFormat(IString* format) = 0;
    // A new string, or null.
    virtual IString* CovertVextralDateTimeToString(double value) const = 0;
    // True when `value` is a date-time that the host can show.
    virtual bool ValidVextralTime(double value) const = 0;
    // The serial day number of now.
    virtual double GetCurrentVextralTime() const = 0;
};

}  // namespace dp
