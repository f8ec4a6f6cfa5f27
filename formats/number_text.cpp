#include "dpxlsx/formats/number_text.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstddef>
#include <iterator>
#include <limits>
#include <system_error>

#include "dpxlsx/formats/digits.h"
#include "dpxlsx/formats/input_decimal.h"

namespace dp {
namespace {

constexpr int kLeastDigits = 14;
constexpr int kMostDigits = std::numeric_limits<double>::max_digits10;

// Sign, the 309 digits of the largest double, the point and an exponent, with some room.
constexpr std::size_t kLongestWithoutDecimals = 330;

std::string rendered(double value, std::chars_format notation, int precision) {
    char buffer[kLongestWithoutDecimals + 32];
    auto result = std::to_chars(std::begin(buffer), std::end(buffer), value, notation, precision);
    if (result.ec == std::errc()) return std::string(buffer, result.ptr);

    std::string text(kLongestWithoutDecimals + static_cast<std::size_t>(precision), '\0');
    result = std::to_chars(text.data(), text.data() + text.size(), value, notation, precision);
    text.resize(static_cast<std::size_t>(result.ptr - text.data()));
    return text;
}

// The value that a stream reads from the text. A text beyond the largest double reads as the
// largest double of the same sign.
double readBack(const std::string& text) {
    double value = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    if (result.ec != std::errc::result_out_of_range) return value;
    return std::copysign(std::numeric_limits<double>::max(), text.front() == '-' ? -1.0 : 1.0);
}

// The count of digits of the shortest text that reads back as the finite `value`.
int shortestDigits(double value) {
    char buffer[32];
    const auto result =
        std::to_chars(std::begin(buffer), std::end(buffer), value, std::chars_format::scientific);
    char* const mantissaEnd = std::find(buffer, result.ptr, 'e');
    return static_cast<int>(std::count_if(buffer, mantissaEnd, isDigit));
}

// Whether the next doubles on both sides are equally far away. Below a power of two doubles are
// twice as dense as above it: the nearest decimal may then read back as another double although a
// slightly farther one reads back correctly. The largest double has no neighbour above.
bool hasEvenNeighbours(double value) {
    int exponent = 0;
    return std::fabs(std::frexp(value, &exponent)) != 0.5 &&
           std::fabs(value) != std::numeric_limits<double>::max();
}

}  // namespace

std::string fixedText(double value, int decimals) {
    return rendered(value, std::chars_format::fixed, decimals);
}

std::string generalText(double value, int significantDigits) {
    return rendered(value, std::chars_format::general, significantDigits);
}

std::string scientificText(double value, int decimals) {
    std::string text = rendered(value, std::chars_format::scientific, decimals);
    const auto upper = [](char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 32) : c; };
    std::transform(text.begin(), text.end(), text.begin(), upper);
    return text;
}

int roundTripDigits(double value) {
    if (!std::isfinite(value)) return kMostDigits;
    if (hasEvenNeighbours(value)) return std::max(kLeastDigits, shortestDigits(value));

    int digits = kLeastDigits;
    while (digits < kMostDigits && readBack(generalText(value, digits)) != value) ++digits;
    return digits;
}

void tidyScientific(std::string& text, int decimals) {
    const std::size_t mark = text.find('E');
    if (mark == std::string::npos) return;
    const bool longExponent = text.size() == mark + std::size("E+000") - 1;
    if (longExponent && text[mark + 2] == '0') text.erase(mark + 2, 1);

    std::size_t kept = mark;
    for (int left = decimals; left > 0 && kept > 0 && text[kept - 1] == '0'; --left) --kept;
    if (decimals > 0 && kept > 0 && text[kept - 1] == '.') --kept;
    text.erase(kept, mark - kept);
}

void useInputDecimal(std::string& text) {
    const std::size_t point = text.find('.');
    if (point != std::string::npos) text[point] = inputDecimal();
}

}  // namespace dp
