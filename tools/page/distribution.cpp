#include "tools/page/distribution.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace dp::tool {

namespace {

double medianOf(std::vector<double>& numbers) {
    const auto middle = numbers.begin() + static_cast<std::ptrdiff_t>(numbers.size() / 2);
    std::nth_element(numbers.begin(), middle, numbers.end());
    if (numbers.size() % 2 == 1) return *middle;
    return std::midpoint(*std::max_element(numbers.begin(), middle), *middle);
}

bool isWhole(double number) { return number == std::trunc(number); }

// The place of a number in its range, from 0 to 1. Halves, because the range itself may be too
// large for a number.
double placeIn(const Distribution& range, double number) {
    const double width = range.greatest / 2 - range.least / 2;
    return width > 0 ? (number / 2 - range.least / 2) / width : 0;
}

size_t binOf(const Distribution& range, double number) {
    if (range.eachNumber) return static_cast<size_t>(number - range.least);
    const auto bins = static_cast<double>(range.bins.size());
    const auto bin = static_cast<size_t>(placeIn(range, number) * bins);
    return std::min(bin, range.bins.size() - 1);  // the last part includes the greatest
}

// Few numbers would leave most of many bins empty.
size_t binsFor(size_t numbers, size_t most) {
    const auto some = static_cast<size_t>(std::ceil(2 * std::sqrt(static_cast<double>(numbers))));
    return std::min(most, some);
}

}  // namespace

Distribution distributionOf(std::vector<double> numbers, size_t most) {
    Distribution result;
    if (numbers.empty()) return result;
    const auto [least, greatest] = std::minmax_element(numbers.begin(), numbers.end());
    result.least = *least;
    result.greatest = *greatest;
    result.median = medianOf(numbers);
    const double range = result.greatest - result.least;
    result.eachNumber =
        range < static_cast<double>(most) && std::all_of(numbers.begin(), numbers.end(), isWhole);
    result.bins.resize(result.eachNumber ? static_cast<size_t>(range) + 1
                                         : binsFor(numbers.size(), most));
    for (const double number : numbers) ++result.bins[binOf(result, number)];
    return result;
}

}  // namespace dp::tool
