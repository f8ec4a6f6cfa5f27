#pragma once

#include "export.h"

// How the values of a column are shown. A format is a plain heap object: whoever holds it deletes
// it; that of a column belongs to the column. Texts that an operation makes are new objects owned
// by the caller; texts that a getter returns belong to the format. A format knows nothing of
// missing values: hosts compare with theirs before they render.
namespace dp {

class IString;

// How a number is written. There is no 3.
enum class NumericSubtype : int {
    General = 0,     // with as many digits as the value needs
    Fixed = 1,       // with a fixed number of decimals
    Scientific = 2,  // with an exponent: "1.5E+05"
    Percentage = 4,  // IPercentageVariableFormat
    Fraction = 5     // IFractionVariableFormat; no import makes one
};

class DPXLSX_API IVariableFormat {
  public:
    // The interfaces of formats: INumericVariableFormat, IDateTimeVariableFormat and
    // ITextVariableFormat.
    enum class FormatType : int { Numeric = 0, DateTime = 1, Text = 2 };

    virtual ~IVariableFormat() = default;

    // Which of these interfaces the format has.
    virtual FormatType GetType() const = 0;
    // True when the host may choose the display itself. Always true for the library's date-time
    // formats, also for those with a pattern; of numbers only for the general format.
    virtual bool GetAuto() const = 0;
    // The display text of `value`, a new string, with the decimal symbol of SetInputDecimal; never
    // null from the library. Pass false to display a value as the workbook does. True does not give
    // all digits, in spite of the name: the format then ignores its count of decimals, and a
    // fixed format shows whole numbers ("3" for 2.75), a percentage one significant digit ("1e+01%"
    // for 0.1234), a scientific format as many digits as the value needs. General and date-time
    // formats show the same either way.
    virtual IString* FormatValue(double value, bool fullPrecision) const = 0;
};

// Out-pointers may be null and are then skipped.
class DPXLSX_API INumericVariableFormat : public IVariableFormat {
  public:
    // How numbers are written; tells a percentage or fraction format from others.
    virtual NumericSubtype GetNumericSubtype() const = 0;
    // The decimals of fixed and scientific notation, where 0 in the latter means as many as the
    // value needs, 0 for other subtypes; and significant digits, always 0 from an import.
    virtual void GetDecimalPlaces(int* decimalPlaces, int* significantDigits) const = 0;
    // The range of the values; always 0 and 0 from an import.
    virtual void GetValueRange(double* low, double* high) const = 0;
    // Whether values are to be shown without the format's decimal places; always false from an
    // import.
    virtual bool ShowFullPrecision() const = 0;
};

// Shows 0.1234 as "12.34%".
class DPXLSX_API IPercentageVariableFormat : public INumericVariableFormat {
  public:
    using INumericVariableFormat::GetDecimalPlaces;
    // Decimals of the percentage itself: 2 for "12.34%". The operation with two out-pointers
    // does not tell them.
    virtual int GetDecimalPlaces() const = 0;
};

// Shows 2.5 as "2 2/4". No import makes one.
class DPXLSX_API IFractionVariableFormat : public INumericVariableFormat {
  public:
    // 4 for "2 2/4"; counts only with GetFixedDenominator().
    virtual int GetDenominator() const = 0;
    // Decimals with which the whole part is written.
    virtual int GetMaximumDigits() const = 0;
    // True for "2 2/4", false for "10/4".
    virtual bool GetMixedFraction() const = 0;
    // False: values are shown as the empty text, unless full precision is asked for.
    virtual bool GetFixedDenominator() const = 0;
};

// FormatValue answers the empty text: texts are shown as they are.
class DPXLSX_API ITextVariableFormat : public IVariableFormat {
  public:
    // Length of the column's longest text in bytes, at least 1 for a loaded column.
    virtual int GetCharacterCount() const = 0;
};

// Date-times are serial day numbers of the 1900 system: 1 is 1900-01-01, 25569 is 1970-01-01, 60 is
// the day 1900-02-29 that never was; the fraction is the time of day. The host gives the provider
// an implementation of its own, the helper, to convert and check date-times. The library's own
// formats only render: they answer what is asked of a helper with false, 0 or null.
class DPXLSX_API IDateTimeVariableFormat : public IVariableFormat {
  public:
    // Four numbers whose meaning is the host's; 0 in the library's formats until
    // SetDateTimeParameters. Null pointers are skipped.
    virtual void GetDateTimeParameters(unsigned* p1, unsigned* p2, unsigned* p3,
                                       unsigned* p4) const = 0;
    // Takes over the four parameters of `other`, which is borrowed for the call; null changes
    // nothing. Before a helper renders a cell by FormatValue, it gets the cell's format here.
    virtual void SetDateTimeParameters(const IDateTimeVariableFormat* other) = 0;
    // The ICU date pattern, empty for ICU's medium date style; never null from the library.
    virtual const IString* GetFormatString() const = 0;

    // --- What a helper alone answers ---
    // Reads `text` by the ICU pattern `format`, null when the column has none yet; both are
    // borrowed for the call. Sets `value` to a serial day number; on failure returns false, the
    // cell is then missing, and leaves `value` as it was.
    virtual bool ConvertToDatetime(const IString* format, IString* text, double& value) const = 0;
    // The serial day number of a calendar time, months and days counted from 1. Asked for dates of
    // XML Spreadsheet 2003 documents only; the numbers are those of the text, unchecked. A time
    // without a date comes as one of 1899-12-30.
    virtual double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                                int millisecond) const = 0;
    // The library never calls this.
    virtual void SetGlobalDateTimeFormat(IString* format) = 0;
    // `value` as text, a new string or null. The library never calls this.
    virtual IString* CovertVextralDateTimeToString(double value) const = 0;
    // True when `value` is a date-time that the host can show. Asked for every number in a
    // date-time column; false makes the cell missing.
    virtual bool ValidVextralTime(double value) const = 0;
    // The serial day number of now. The library never calls this.
    virtual double GetCurrentVextralTime() const = 0;
};

}  // namespace dp
