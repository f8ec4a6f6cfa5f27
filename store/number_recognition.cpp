#include "dpxlsx/store/number_recognition.h"

#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <locale>
#include <sstream>
#include <string_view>
#include <system_error>

#include "dpxlsx/store/text_cleaning.h"

namespace dp {

namespace {

enum ByteClass : std::uint8_t { kDigit, kPlus, kMinus, kPoint, kExponent, kOther };

constexpr std::uint8_t kStart = 0;
constexpr std::uint8_t kReject = 2;

// The next state by state (row) and class of the byte (column). State 1 is never entered.
constexpr std::array<std::array<std::uint8_t, 5>, 13> kNext{{
    // digit plus minus point exponent
    {5, 4, 3, 8, 2},    // 0: start
    {2, 2, 2, 2, 2},    // 1
    {2, 2, 2, 2, 2},    // 2: rejected
    {5, 2, 2, 8, 2},    // 3: after a leading minus
    {5, 2, 2, 2, 2},    // 4: after a leading plus
    {5, 2, 2, 9, 10},   // 5: integer digits
    {6, 2, 2, 2, 10},   // 6: digits after a leading point
    {7, 2, 2, 2, 2},    // 7: exponent digits
    {6, 2, 2, 2, 2},    // 8: point with no digit before it
    {9, 2, 2, 2, 10},   // 9: point after digits, and the digits after it
    {7, 12, 11, 2, 2},  // 10: exponent marker
    {7, 2, 2, 2, 2},    // 11: exponent minus
    {7, 2, 2, 2, 2},    // 12: exponent plus
}};

constexpr bool accepts(std::uint8_t state) {
    return state == 5 || state == 6 || state == 7 || state == 9;
}

ByteClass classify(char byte, bool decimalSeen) {
    if (byte >= '0' && byte <= '9') return kDigit;
    switch (byte) {
        case '+':
            return kPlus;
        case '-':
            return kMinus;
        case '.':
            return decimalSeen ? kPoint : kOther;
        case 'D':
        case 'E':
        case 'd':
        case 'e':
            return kExponent;
        default:
            return kOther;
    }
}

// Runs the automaton over `text` and rewrites it for the conversion: the decimal symbol becomes a
// point, D becomes E.
bool recognise(std::string& text, char decimal) {
    std::uint8_t state = kStart;
    bool decimalSeen = false;
    for (char& byte : text) {
        if (byte == decimal) {
            byte = '.';
            decimalSeen = true;
        }
        const ByteClass kind = classify(byte, decimalSeen);
        state = kind == kOther ? kReject : kNext[state][kind];
        if (state == kReject) return false;
        if (kind == kExponent) byte = 'E';
    }
    return accepts(state);
}

// The number of a text that is out of a double's range: infinity when it is too large, the nearest
// subnormal number or zero when it is too small.
double convertExtreme(const std::string& text) {
    std::istringstream stream(text);
    stream.imbue(std::locale::classic());
    double value = 0.0;
    stream >> value;
    return std::abs(value) >= 1.0 ? HUGE_VAL : value;
}

double convert(const std::string& text) {
    std::string_view digits = text;
    if (digits.front() == '+') digits.remove_prefix(1);
    double value = 0.0;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), value);
    return result.ec == std::errc::result_out_of_range ? convertExtreme(text) : value;
}

}  // namespace

bool recogniseNumber(const std::string& text, char decimal, double missing, double* value) {
    *value = missing;
    std::string number = text;
    trim(number);
    if (!number.empty() && number.front() == '(' && number.back() == ')') {
        number.front() = '-';
        number.pop_back();
    }
    if (!recognise(number, decimal)) return false;
    const double converted = convert(number);
    if (!std::isfinite(converted)) return false;
    // The sum turns a negative zero into +0.0 and changes nothing else.
    *value = converted + 0.0;
    return true;
}

}  // namespace dp
