#pragma once

#include <string>

// Numbers as the classic locale's output streams write them in the default rounding mode, whatever
// locale the process has set.
// A negative count of decimals or digits means 6, as it does for a stream.
namespace dp {

// Fixed notation. The text has no grouping and "." as its decimal point.
std::string fixedText(double value, int decimals);

// General notation; 0 digits count as 1.
std::string generalText(double value, int significantDigits);

// Scientific notation with upper-case letters ("1.50E+05", "INF") and `decimals` digits after the
// point.
std::string scientificText(double value, int decimals);

// The least count of significant digits from 14 to 17 with which general notation reads back as
// `value`; 17 when none does. As for a stream, a text above the largest double reads as the
// largest double.
int roundTripDigits(double value);

// Removes up to `decimals` trailing zeros from the mantissa of a scientific text, the point too
// when all `decimals` are zeros, and the leading zero of a three-digit exponent.
void tidyScientific(std::string& text, int decimals);

// Replaces the first "." of the text by the process-wide input decimal symbol.
void useInputDecimal(std::string& text);

}  // namespace dp
