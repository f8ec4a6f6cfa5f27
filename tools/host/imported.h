#pragma once

#include <map>
#include <set>
#include <string>

#include "tools/host/column.h"

namespace dp::tool {

// What an import made of a worksheet. Rows and columns are 1-based.
struct ImportedSheet {
    int key;
    unsigned nameRow;  // 0 for none
    unsigned firstDataRow;
    std::map<unsigned, Kind> columns;
    std::set<unsigned> leftOut;  // columns, by an option
    std::set<unsigned> chosen;   // columns whose kind was set by an option
};

// What an import made of a book.
struct Imported {
    std::map<std::string, ImportedSheet> sheets;  // by title
    std::set<std::string> leftOut;                // worksheets, by an option
    bool cleaned = false;  // whether the titles are without the characters that hosts cannot have
};

}  // namespace dp::tool
