// Numbers of XML documents: the locale-independent conversion beside the C library's. Ends with 1
// when the goal is missed, and with 2 when the two differ.

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include "bench/verify.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"

namespace {

std::vector<std::string> decimalTexts(const char* format) {
    std::mt19937_64 random(7);
    std::uniform_real_distribution<double> values(-1e6, 1e6);
    std::vector<std::string> texts;
    char text[64];
    for (int i = 0; i < 200'000; ++i) {
        std::snprintf(text, sizeof text, format, values(random));
        texts.emplace_back(text);
    }
    return texts;
}

constexpr int kRounds = 5;

// Nanoseconds per text, the best of some rounds. Every round adds up its results, so that the
// compiler cannot remove the conversions.
template <class Convert>
double measure(const std::vector<std::string>& texts, double& sum, Convert convert) {
    double best = 1e9;
    for (int round = 0; round < kRounds; ++round) {
        const auto start = std::chrono::steady_clock::now();
        for (const std::string& text : texts) sum += convert(text.c_str());
        const std::chrono::duration<double, std::nano> taken =
            std::chrono::steady_clock::now() - start;
        best = std::min(best, taken.count() / static_cast<double>(texts.size()));
    }
    return best;
}

bool compare() {
    constexpr double kGoal = 0.5;
    const CmXmlCast& cast = CmXmlCast::instance();
    bool reached = true;
    std::printf("%-24s %9s %9s %7s %6s\n", "numbers, ns a text", "mCast", "atof", "ratio", "goal");
    for (const char* format : {"%.3f", "%.17g", "%.0f"}) {
        const std::vector<std::string> texts = decimalTexts(format);
        double sum = 0;
        double floorSum = 0;
        const double ours = measure(texts, sum, [&cast](const char* text) {
            double value = 0.0;
            cast.mCast(value, text);
            return value;
        });
        const double floor =
            measure(texts, floorSum, [](const char* text) { return std::atof(text); });
        bench::require(sum == floorSum && sum != 0, "the two do not convert to the same numbers");
        std::printf("%-24s %9.1f %9.1f %7.2f %6.2f\n", format, ours, floor, ours / floor, kGoal);
        reached = reached && ours <= kGoal * floor;
    }
    return reached;
}

}  // namespace

int main() {
    return bench::resultOf([] { return compare() ? 0 : 1; });
}
