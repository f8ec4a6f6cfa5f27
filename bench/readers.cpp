// Numbers of XML documents: the locale-independent conversion beside the C library's.

#include <cstdio>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include "bench/harness.h"
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

double cast(const char* text) {
    double value = 0.0;
    CmXmlCast::instance().mCast(value, text);
    return value;
}

// The loop over the texts, whose values must have that sum.
template <class Convert>
bench::Loop loopOf(const std::vector<std::string>& texts, double expected, Convert convert) {
    return [&texts, expected, convert] {
        double sum = 0;
        for (const std::string& text : texts) sum += convert(text.c_str());
        bench::require(sum == expected && sum != 0, "the two do not convert to the same numbers");
        return static_cast<double>(texts.size());
    };
}

void measureAll(bench::Report& report) {
    for (const char* format : {"%.3f", "%.17g", "%.0f"}) {
        const std::vector<std::string> texts = decimalTexts(format);
        double sum = 0;
        for (const std::string& text : texts) sum += std::atof(text.c_str());
        bench::addLoops(report, std::string("numbers written by ") + format + " / atof, ns", {0.5},
                        loopOf(texts, sum, cast),
                        loopOf(texts, sum, [](const char* text) { return std::atof(text); }));
    }
}

}  // namespace

int main(int argc, char** argv) { return bench::run(argc, argv, measureAll); }
