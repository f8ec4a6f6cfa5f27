#pragma once

#include <cstddef>
#include <vector>

namespace dp::tool {

// How numbers are spread between the least and the greatest of them.
struct Distribution {
    double least = 0;
    double median = 0;  // the mean of the two in the middle when their number is even
    double greatest = 0;
    bool eachNumber = false;   // a bin for each whole number from the least on
    std::vector<size_t> bins;  // else counts in equal parts of the range; empty without numbers
};

// The distribution of finite numbers in at most `most` bins, fewer for few numbers. Whole numbers
// with a small range have a bin each: parts of any other width would hold different numbers of
// them.
Distribution distributionOf(std::vector<double> numbers, size_t most);

}  // namespace dp::tool
