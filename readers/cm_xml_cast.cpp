#include "readers/cm_xml_cast.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <clocale>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <string>
#include <system_error>

namespace {

// Plain decimal numbers, which nearly all are. The rest (white space, a plus, hexadecimal digits,
// text behind the number, values out of range) has its own rules in atof.
bool castPlainDecimal(double& value, const char* text) {
    const char first = *text == '-' ? text[1] : *text;
    const bool startsNumber = (first >= '0' && first <= '9') || first == '.';
    if (!startsNumber) return false;
    const char* end = text + std::strlen(text);
    const auto result = std::from_chars(text, end, value);
    return result.ec == std::errc() && result.ptr == end;
}

// atof reads numbers as the process's locale writes them. Only the last point is its decimal
// separator: "1.234.5" under a decimal comma is 1.
double castByLocale(const char* text) {
    const char point = *std::localeconv()->decimal_point;
    if (point == '.') return std::atof(text);
    std::string copy(text);
    if (const auto last = copy.rfind('.'); last != copy.npos) copy[last] = point;
    return std::atof(copy.c_str());
}

template <class T>
void castInteger(T& value, const char* text) {
    while (std::isspace(static_cast<unsigned char>(*text))) ++text;
    const bool negative = *text == '-';
    if (*text == '-' || *text == '+') ++text;
    std::uint64_t magnitude = 0;
    const auto result = std::from_chars(text, text + std::strlen(text), magnitude);
    if (result.ptr == text) return;
    constexpr auto kLargest = static_cast<std::uint64_t>(std::numeric_limits<T>::max());
    if (result.ec == std::errc::result_out_of_range) magnitude = kLargest;
    const auto bounded = static_cast<T>(std::min(magnitude, kLargest));
    value = negative ? static_cast<T>(T{0} - bounded) : bounded;
}

}  // namespace

CmXmlCast* CmXmlCast::m_pInstance = nullptr;

CmXmlCast& CmXmlCast::instance() {
    if (!m_pInstance) m_pInstance = new CmXmlCast;
    return *m_pInstance;
}

void CmXmlCast::mCast(double& value, const char* text) const {
    if (!castPlainDecimal(value, text)) value = castByLocale(text);
}

void CmXmlCast::mCast(int& value, const char* text) const { castInteger(value, text); }

void CmXmlCast::mCast(unsigned& value, const char* text) const { castInteger(value, text); }
