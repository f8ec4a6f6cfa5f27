#pragma once

#include <cstdio>
#include <exception>
#include <functional>
#include <stdexcept>
#include <string>

#include "model/host/i_column.h"
#include "model/host/i_data_provider.h"
#include "model/host/i_finders.h"

// A benchmark says what it measured only if the work was done: every figure is of values that were
// counted.
namespace bench {

// Throws when the work was not done, or not on as many values as it should.
inline void require(bool holds, const std::string& what) {
    if (!holds) throw std::runtime_error(what);
}

inline void requireCount(unsigned long found, unsigned long expected, const std::string& what) {
    require(found == expected,
            what + ": " + std::to_string(found) + " instead of " + std::to_string(expected));
}

// The result of a whole program: its own, or 2 with a line on the standard error stream when
// something was not done. A missed goal is 1.
inline int resultOf(const std::function<int()>& program) {
    try {
        return program();
    } catch (const std::exception& e) {
        std::fprintf(stderr, "benchmark: %s\n", e.what());
        return 2;
    }
}

// Calls `use` with every column of every worksheet, as a host gets them; each goes afterwards
// unless `use` takes a reference.
template <class Use>
void forEachColumn(dp::IDataProvider& provider, const Use& use) {
    const auto& worksheets = *provider.GetWorksheetFinder()->GetWorksheetPrimeKeys();
    const dp::IVariableFinder& finder = *provider.GetVariableFinder();
    for (unsigned long sheet = 0; sheet < worksheets.Count(); ++sheet) {
        const auto& keys = *finder.GetColumnPrimeKeys(worksheets.Item(sheet));
        for (unsigned long key = 0; key < keys.Count(); ++key) {
            dp::IColumn* column = nullptr;
            if (!finder.FindColumn(keys.Item(key), &column, false)) continue;
            column->AddRef();
            use(*column);
            column->Release();
        }
    }
}

// How many values a column has, without the missing ones.
inline unsigned long valuesOf(const dp::IColumn& column) {
    return static_cast<unsigned long>(column.GetRowCount() - column.GetMissingCount());
}

}  // namespace bench
