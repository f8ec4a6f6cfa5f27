#pragma once

#include <string>

#include <dpxlsx/model/host/i_data_provider.h>

#include "tools/explain/tally.h"
#include "tools/host/column.h"
#include "tools/options/options.h"

namespace dp::tool {

// Counts what the columns of an import lost.
class Losses {
  public:
    explicit Losses(const Options& options) : options_(options) {}

    // Counts the losses of a loaded column. Loads the column once more only where the library's own
    // counts are not sufficient (with marks of missing values that the user declared, and with
    // texts of exactly the maximum length), because that takes time. `place` is the worksheet and
    // the column's letters, such as "Data!B".
    void note(IDataProvider& provider, const std::string& place, const Column& column);

    // Counts the numbers and dates in a loaded column of texts whose displayed form does not show
    // the whole value. Loads the column once more.
    void noteShown(IDataProvider& provider, const std::string& place, const Column& column);

    const Lost& lost() const { return lost_; }
    // One line about lost cells, one about unreadable cells, another about cut texts: how many,
    // where, and what keeps them; empty when there are none.
    std::string cellsNote() const;
    std::string unreadableNote() const;
    std::string textsNote() const;

  private:
    void noteCells(IDataProvider& provider, const std::string& place, const Column& column);
    void noteTexts(IDataProvider& provider, const std::string& place, const Column& column);

    const Options& options_;
    Lost lost_;
};

}  // namespace dp::tool
