#pragma once

#include <map>
#include <string>

#include "tools/findings.h"
#include "tools/library.h"

namespace dp::tool {

// What the library makes of numbers of a cell style.
struct StyleAnswer {
    bool isDate;
    bool hasPattern;  // a date that keeps the look of its code
};

// Asks the library itself what it makes of each cell style in `formats`: a package with the style
// sheet of `book` and one cell of each style is made in the temporary directory and imported. That
// holds for whatever the library decides, and for style sheets that it reads otherwise than meant;
// a copy of its rules would only hold until they change. Empty when there is no such answer.
std::map<int, StyleAnswer> askForStyles(const Library& library, const std::string& book,
                                        const std::map<int, UsedFormat>& formats);

}  // namespace dp::tool
