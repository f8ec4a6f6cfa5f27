#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <vector>

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/store/cell_column.h"
#include "dpxlsx/store/external_data_record.h"

namespace dp {

// The cells of one worksheet, an ordered map from column (0-based) to CellColumn. Not thread-safe;
// worksheets that share a pool count as one object. After settle() of all of them, reads change
// nothing.
class DPXLSX_API WorksheetCells {
    using Columns = std::map<unsigned, CellColumn>;

  public:
    using value_type = Columns::value_type;
    using const_iterator = Columns::const_iterator;
    using const_reverse_iterator = Columns::const_reverse_iterator;

    // All columns keep their texts in `texts`; when that is null, in one pool made for them.
    explicit WorksheetCells(std::shared_ptr<TextPool> texts = nullptr);
    WorksheetCells(WorksheetCells&& other) noexcept;
    WorksheetCells& operator=(WorksheetCells&& other) noexcept;
    ~WorksheetCells();

    // Files one cell at its row and column, replacing the one that is there. Throws std::bad_alloc
    // and the cells are then as before. Calls for the same column as the call before, the next one
    // to its right or the leftmost one need no search.
    void add(const ExternalDataRecord& record);
    // The cells of `column`, an empty CellColumn if there were none.
    CellColumn& operator[](unsigned column);
    void clear() noexcept;

    // The pool that keeps this worksheet's texts, made if there is none yet.
    const std::shared_ptr<TextPool>& texts();

    std::size_t size() const { return columns_.size(); }
    bool empty() const { return columns_.empty(); }
    const_iterator begin() const { return columns_.begin(); }
    const_iterator end() const { return columns_.end(); }
    const_reverse_iterator rbegin() const { return columns_.rbegin(); }
    const_reverse_iterator rend() const { return columns_.rend(); }
    const_iterator find(unsigned column) const { return columns_.find(column); }
    const_iterator lower_bound(unsigned column) const { return columns_.lower_bound(column); }
    const_iterator upper_bound(unsigned column) const { return columns_.upper_bound(column); }
    std::size_t count(unsigned column) const { return columns_.count(column); }

    // The column number and cells of the `position`-th column (0-based) in ascending order;
    // `position` is below size().
    const value_type& nth(std::size_t position) const;
    // The largest row of all columns plus one, 0 without cells.
    std::uint64_t rowCount() const;
    // Settles all columns.
    void settle() const;

    // The number of columns in all worksheets before this one. The provider, which numbers columns
    // across worksheets, keeps it here: public, because only the provider knows the other
    // worksheets, and mutable, because const queries compute it. It belongs to this worksheet's
    // position in the workbook, not to its cells, so a move of the cells leaves it behind.
    mutable std::optional<std::size_t> columnsBefore;

  private:
    CellColumn* known(unsigned column);
    template <typename File>
    void file(unsigned column, const File& fileIn);
    const std::vector<const value_type*>& inOrder() const;

    std::shared_ptr<TextPool> texts_;
    Columns columns_;
    Columns::iterator recent_;  // the column of the last cell filed, if any
    // The columns by number, made when a query that is const first needs them: therefore mutable.
    // Outdated while its size is not that of columns_.
    mutable std::vector<const value_type*> inOrder_;
};

}  // namespace dp
