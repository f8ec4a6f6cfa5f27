#include "dpxlsx/readers/xml/cm_xml_cast.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <clocale>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <string>
#include <string_view>
#include <system_error>

#include "dpxlsx/formats/digits.h"

namespace {

// Numbers of few digits, as nearly all are. An integer below 2^53 divided by a power of ten up to
// 10^22 is rounded only once, so the result is the same double that a full conversion gives.
bool castShortDecimal(double& value, const char* text) {
    constexpr std::size_t kDigits = 15;  // always below 2^53
    constexpr double kPowers[kDigits + 1] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                             1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
    const bool negative = *text == '-';
    if (negative) ++text;
    std::int64_t whole = 0;
    std::size_t digits = 0;
    std::size_t decimals = 0;
    for (; dp::isDigit(*text); ++text, ++digits) {
        if (digits == kDigits) return false;
        whole = whole * 10 + (*text - '0');
    }
    if (digits == 0) return false;
    if (*text == '.')
        for (++text; dp::isDigit(*text); ++text, ++digits, ++decimals) {
            if (digits == kDigits) return false;
            whole = whole * 10 + (*text - '0');
        }
    if (*text != '\0') return false;
    const double magnitude = static_cast<double>(whole) / kPowers[decimals];
    value = negative ? -magnitude : magnitude;
    return true;
}

// Other plain decimal numbers. The rest (white space, a plus, hexadecimal digits, text after the
// number, values out of range) is left to atof, whose rules for it differ.
bool castPlainDecimal(double& value, const char* text) {
    const char first = *text == '-' ? text[1] : *text;
    if (!dp::isDigit(first) && first != '.') return false;
    const char* end = text + std::strlen(text);
    const auto result = std::from_chars(text, end, value);
    return result.ec == std::errc() && result.ptr == end;
}

// atof expects the decimal separator of the process's locale, which may have several bytes; the
// last point is replaced by it. Earlier points end the number: "1.234.5" under a decimal comma is
// 1.
double castByLocale(const char* text) {
    const std::string_view point = std::localeconv()->decimal_point;
    if (point == ".") return std::atof(text);
    std::string copy(text);
    if (const auto last = copy.rfind('.'); last != copy.npos) copy.replace(last, 1, point);
    return std::atof(copy.c_str());
}

// The sign and digits of an integer, the magnitude at most the largest 64-bit number.
struct ScannedInteger {
    bool found = false;
    bool negative = false;
    std::uint64_t magnitude = 0;
};

ScannedInteger scanInteger(const char* text) {
    while (std::isspace(static_cast<unsigned char>(*text))) ++text;
    ScannedInteger scanned;
    scanned.negative = *text == '-';
    if (*text == '-' || *text == '+') ++text;
    const auto result = std::from_chars(text, text + std::strlen(text), scanned.magnitude);
    scanned.found = result.ptr != text;
    if (result.ec == std::errc::result_out_of_range)
        scanned.magnitude = std::numeric_limits<std::uint64_t>::max();
    return scanned;
}

}  // namespace

CmXmlCast* CmXmlCast::m_pInstance = nullptr;

CmXmlCast& CmXmlCast::instance() {
    static CmXmlCast& made = *(m_pInstance = new CmXmlCast);
    return made;
}

void CmXmlCast::mCast(double& value, const char* text) const {
    if (castShortDecimal(value, text) || castPlainDecimal(value, text)) return;
    value = castByLocale(text);
}

bool CmXmlCast::mCast(int& value, const char* text) const {
    const ScannedInteger scanned = scanInteger(text);
    if (!scanned.found) return false;
    constexpr std::uint64_t kLargest = std::numeric_limits<int>::max();
    const auto bounded = static_cast<std::int64_t>(
        std::min(scanned.magnitude, scanned.negative ? kLargest + 1 : kLargest));
    value = static_cast<int>(scanned.negative ? -bounded : bounded);
    return true;
}

bool CmXmlCast::mCast(unsigned& value, const char* text) const {
    const ScannedInteger scanned = scanInteger(text);
    if (!scanned.found) return false;
    constexpr std::uint64_t kLargest = std::numeric_limits<unsigned>::max();
    const auto bounded = static_cast<unsigned>(std::min(scanned.magnitude, kLargest));
    const bool wraps = scanned.negative && scanned.magnitude <= kLargest;
    value = wraps ? 0U - bounded : bounded;
    return true;
}
