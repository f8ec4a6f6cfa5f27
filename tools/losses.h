#pragma once

#include <string>
#include <vector>

#include "model/host/i_data_provider.h"
#include "tools/column.h"
#include "tools/options.h"

namespace dp::tool {

// Cells that had content but became missing values, because it did not fit the kind of their
// column.
class Losses {
  public:
    explicit Losses(const Options& options) : options_(options) {}

    // Counts those of a loaded column. Where the user's own marks of missing values make the
    // library count more, the column is loaded once more; otherwise that would only take time.
    void note(IDataProvider& provider, const std::string& worksheet, const Column& column);
    // One line that says how many, where, and which options keep them; empty when there are none.
    std::string text() const;

  private:
    struct Loss {
        std::string place;  // such as "Data!B"
        std::string name;
        size_t cells;
    };

    unsigned numberOf(const std::string& worksheet, const Column& column) const;

    const Options& options_;
    std::vector<Loss> losses_;
};

}  // namespace dp::tool
