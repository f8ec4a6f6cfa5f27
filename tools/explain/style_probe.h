#pragma once

#include <map>
#include <string>

#include "tools/explain/findings.h"
#include "tools/host/library.h"

namespace dp::tool {

// How the library treats the numbers of a cell style.
struct StyleAnswer {
    bool isDate;
    bool hasPattern;  // a date that is displayed as its format code says
};

// Determines how the library treats each cell style in `formats` by importing a package that is
// made in the temporary directory, with the style sheet of `book` and one cell of each style, by
// the standard or by the default rules. Unlike a copy of the library's rules, this cannot become
// outdated, and it covers style sheets that the library misreads. Empty when the probe cannot be
// imported.
std::map<int, StyleAnswer> askForStyles(const Library& library, const std::string& book,
                                        const std::map<int, UsedFormat>& formats, bool standard);

}  // namespace dp::tool
