#pragma once

#include <cstddef>
#include <string>

#include "model/host/i_data_provider.h"
#include "tools/column.h"
#include "tools/options.h"
#include "tools/tally.h"

namespace dp::tool {

// Counts what the columns of an import lost.
class Losses {
  public:
    explicit Losses(const Options& options) : options_(options) {}

    // Counts in a loaded column. Where the library's own counts leave a doubt (the user's marks of
    // missing values, texts of just the longest length) the column is loaded once more; otherwise
    // that would only take time.
    // `place` is the worksheet and the column's letters, such as "Data!B".
    void note(IDataProvider& provider, const std::string& place, const Column& column);

    // Counts numbers and dates that a loaded column of texts has as displayed, where that leaves
    // some of them out. The column is loaded once more.
    void noteShown(IDataProvider& provider, const std::string& place, const Column& column);

    const Lost& lost() const { return lost_; }
    // One line about the cells: how many, where, and which options keep them; empty when there are
    // none. Another one about the texts.
    std::string cellsNote() const;
    std::string textsNote() const;

  private:
    void noteCells(IDataProvider& provider, const std::string& place, const Column& column);
    void noteTexts(IDataProvider& provider, const std::string& place, const Column& column);

    const Options& options_;
    Lost lost_;
};

}  // namespace dp::tool
