#pragma once

#include <cstdio>
#include <exception>
#include <functional>
#include <stdexcept>
#include <string>

#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_data_provider.h"
#include "dpxlsx/model/host/i_finders.h"
#include "dpxlsx/model/host/reference.h"

// A benchmark reports a figure only if the work was done: the values behind every figure are
// counted.
namespace bench {

// Throw when the work was not done, or not on the expected number of values.
inline void require(bool holds, const std::string& what) {
    if (!holds) throw std::runtime_error(what);
}

inline void requireCount(unsigned long found, unsigned long expected, const std::string& what) {
    require(found == expected,
            what + ": " + std::to_string(found) + " instead of " + std::to_string(expected));
}

// Runs a program's main function and returns its exit code (1 for a missed goal); when it throws,
// prints a line on standard error and returns 2.
inline int resultOf(const std::function<int()>& program) {
    try {
        return program();
    } catch (const std::exception& e) {
        std::fprintf(stderr, "benchmark: %s\n", e.what());
        return 2;
    }
}

// Calls `use` with every column of every worksheet, as a host gets them. Columns are released
// afterwards unless `use` takes a reference.
template <class Use>
void forEachColumn(dp::IDataProvider& provider, const Use& use) {
    const auto& worksheets = *provider.GetWorksheetFinder()->GetWorksheetPrimeKeys();
    const dp::IVariableFinder& finder = *provider.GetVariableFinder();
    for (unsigned long sheet = 0; sheet < worksheets.Count(); ++sheet) {
        const auto& keys = *finder.GetColumnPrimeKeys(worksheets.Item(sheet));
        for (unsigned long key = 0; key < keys.Count(); ++key) {
            dp::IColumn* column = nullptr;
            if (!finder.FindColumn(keys.Item(key), &column, false)) continue;
            use(*dp::Reference(column));
        }
    }
}

// The number of a column's values that are not missing.
inline unsigned long valuesOf(const dp::IColumn& column) {
    return static_cast<unsigned long>(column.GetRowCount() - column.GetMissingCount());
}

}  // namespace bench
