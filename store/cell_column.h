#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/store/external_data_record.h"
#include "dpxlsx/store/pooled_text.h"

namespace dp {

class TextPool;

// A cell that does not fit into a PackedCell: more fields than the one its type names are set, the
// type has no name, or the format index needs more bits.
struct RareCell {
    ExternalCellType type;
    std::int32_t intValue;
    std::int32_t boolValue;
    double numValue;
    PooledText textValue;
    std::int32_t formatIndex;
};

// A cell as a column keeps it. The kind is the cell's type, or kRare when `value` is the address
// of a RareCell; otherwise `value` holds the bits of the one field that the type names.
struct PackedCell {
    static constexpr unsigned kKindBits = 4;
    static constexpr std::uint32_t kRare = (1U << kKindBits) - 1;

    std::uint32_t row;
    std::uint32_t kindAndFormat;  // the kind, and above it the format index plus one
    std::uint64_t value;

    std::uint32_t kind() const { return kindAndFormat & kRare; }
    const RareCell* rare() const {
        return kind() == kRare ? std::bit_cast<const RareCell*>(value) : nullptr;
    }
};
static_assert(sizeof(PackedCell) == 16);

// Read access to a stored cell. Every field is bit for bit that of the ExternalDataRecordCell that
// was filed, and each getter reads only its own field. Valid until the column changes.
class DPXLSX_API CellView {
  public:
    explicit CellView(const PackedCell& cell) : cell_(cell) {}

    ExternalCellType type() const;
    std::int32_t intValue() const;
    std::int32_t boolValue() const;
    double numValue() const;
    std::string_view textValue() const;
    std::int32_t formatIndex() const;
    PooledText pooledText() const;

    // A copy, the text included.
    operator ExternalDataRecordCell() const;

  private:
    std::int32_t lowHalf() const { return static_cast<std::int32_t>(cell_.value); }

    PackedCell cell_;
};

// A sequence of packed cells in blocks: it grows without moving what it holds, and a short one
// stays small. Blocks of 4, 8, 16 ... cells up to kLargest, then all of that size.
class DPXLSX_API CellBlocks {
  public:
    CellBlocks() = default;
    CellBlocks(CellBlocks&& other) noexcept;

    std::size_t size() const { return size_; }
    // Constness is that of the sequence: the cells may be changed.
    PackedCell& operator[](std::size_t index) const;
    PackedCell& back() const { return next_[-1]; }
    // The end of the contiguous cells in memory that start with the one at `index`.
    const PackedCell* endOfRun(std::size_t index) const;

    // Throws std::bad_alloc and is then unchanged.
    void push(const PackedCell& cell) {
        if (next_ == end_) addBlock();
        *next_++ = cell;
        ++size_;
    }
    void truncate(std::size_t size) noexcept;

  private:
    static constexpr std::size_t kFirst = 4;
    static constexpr std::size_t kLargest = 256;
    static constexpr std::size_t kDoublings = std::bit_width(kLargest / kFirst) - 1;
    static constexpr std::size_t kGrowing =
        2 * kLargest - kFirst;  // cells in all blocks below kLargest and the first of kLargest

    struct Place {
        std::size_t block;
        std::size_t offset;
    };
    static Place placeOf(std::size_t index);
    static std::size_t capacityOf(std::size_t block);
    void addBlock();

    std::vector<std::unique_ptr<PackedCell[]>> blocks_;
    std::size_t size_ = 0;
    PackedCell* next_ = nullptr;  // behind the last cell, in the same block
    PackedCell* end_ = nullptr;   // the end of that block
};

// The cells of one worksheet column, an ordered map from row (0-based) to cell. Cells filed in
// ascending order of rows are appended; cells filed out of order are merged by the next read, which
// may throw std::bad_alloc and then leaves the column unchanged. Any change invalidates iterators
// and views. For thread safety, columns that share a pool count as one object: none may be changed
// while another thread uses any of them. Once all of them are settled, reads change nothing.
class DPXLSX_API CellColumn {
  public:
    struct Entry {
        unsigned first;   // the row
        CellView second;  // its cell
    };
    class const_iterator;
    using iterator = const_iterator;
    using const_reverse_iterator = std::reverse_iterator<const_iterator>;
    using key_type = unsigned;
    using mapped_type = ExternalDataRecordCell;
    using value_type = Entry;
    using size_type = std::size_t;

    // Keeps texts in `texts`; when that is null, in a pool of its own that is made with the first
    // text.
    explicit CellColumn(std::shared_ptr<TextPool> texts = nullptr);
    CellColumn(CellColumn&& other) noexcept;
    ~CellColumn();

    // Sets the cell of `row`, replacing the one that is there. Throws std::bad_alloc and the
    // column's cells are then as before.
    void assign(unsigned row, const ExternalDataRecordCell& cell);
    void clear() noexcept;

    // The pool that keeps this column's texts, made if there is none yet.
    const std::shared_ptr<TextPool>& texts();

    std::size_t size() const;
    bool empty() const { return cells_.size() == 0; }

    const_iterator begin() const;
    const_iterator end() const;
    const_iterator cbegin() const;
    const_iterator cend() const;
    const_reverse_iterator rbegin() const;
    const_reverse_iterator rend() const;
    const_iterator find(unsigned row) const;
    const_iterator lower_bound(unsigned row) const;
    const_iterator upper_bound(unsigned row) const;
    std::size_t count(unsigned row) const;

    // Merges the cells that were filed out of order, and completes the lookups of texts that cells
    // still wait for.
    void settle() const;

  private:
    using RareCells = std::unordered_map<const RareCell*, std::unique_ptr<const RareCell>>;

    // To be called before cells are read, moved, replaced or destroyed: pending lookups of the pool
    // write their results into the cells.
    void settleTexts() const noexcept;
    PackedCell& put(const PackedCell& cell);
    void assignRare(unsigned row, const ExternalDataRecordCell& cell);
    void release(const PackedCell& cell) const noexcept;
    std::vector<PackedCell> lateCells() const;
    void mergeLateCells() const;

    std::shared_ptr<TextPool> texts_;
    // Mutable, because reads merge what was filed out of order.
    mutable CellBlocks cells_;
    mutable std::size_t sorted_ = 0;  // this many cells at the front are in order, one per row
    mutable std::unique_ptr<RareCells> rare_;
};

// Walks a column in ascending order of rows.
class CellColumn::const_iterator {
  public:
    using iterator_category = std::bidirectional_iterator_tag;
    using value_type = Entry;
    using difference_type = std::ptrdiff_t;
    using reference = Entry;
    class pointer {
      public:
        explicit pointer(const Entry& entry) : entry_(entry) {}
        const Entry* operator->() const { return &entry_; }

      private:
        Entry entry_;
    };

    const_iterator() = default;

    Entry operator*() const { return {cell_->row, CellView(*cell_)}; }
    pointer operator->() const { return pointer(**this); }

    const_iterator& operator++() {
        ++index_;
        if (++cell_ == endOfRun_) locate();
        return *this;
    }
    const_iterator& operator--() {
        --index_;
        locate();
        return *this;
    }
    const_iterator operator++(int) {
        const const_iterator before = *this;
        ++*this;
        return before;
    }
    const_iterator operator--(int) {
        const const_iterator before = *this;
        --*this;
        return before;
    }

    friend bool operator==(const const_iterator& left, const const_iterator& right) {
        return left.index_ == right.index_;
    }

  private:
    friend class CellColumn;

    const_iterator(const CellBlocks& cells, std::size_t index) : cells_(&cells), index_(index) {
        locate();
    }
    void locate() {
        if (index_ >= cells_->size()) return;
        cell_ = &(*cells_)[index_];
        endOfRun_ = cells_->endOfRun(index_);
    }

    const CellBlocks* cells_ = nullptr;
    std::size_t index_ = 0;
    const PackedCell* cell_ = nullptr;
    const PackedCell* endOfRun_ = nullptr;
};

inline CellColumn::const_iterator CellColumn::begin() const {
    settle();
    return {cells_, 0};
}

inline CellColumn::const_iterator CellColumn::end() const {
    settle();
    return {cells_, cells_.size()};
}

inline CellColumn::const_iterator CellColumn::cbegin() const { return begin(); }
inline CellColumn::const_iterator CellColumn::cend() const { return end(); }

inline CellColumn::const_reverse_iterator CellColumn::rbegin() const {
    return const_reverse_iterator(end());
}

inline CellColumn::const_reverse_iterator CellColumn::rend() const {
    return const_reverse_iterator(begin());
}

inline ExternalCellType CellView::type() const {
    const RareCell* rare = cell_.rare();
    return rare ? rare->type : static_cast<ExternalCellType>(cell_.kind());
}

inline std::int32_t CellView::intValue() const {
    if (cell_.kind() == CELL_INTEGER) return lowHalf();
    const RareCell* rare = cell_.rare();
    return rare ? rare->intValue : 0;
}

inline std::int32_t CellView::boolValue() const {
    if (cell_.kind() == CELL_BOOLEAN) return lowHalf();
    const RareCell* rare = cell_.rare();
    return rare ? rare->boolValue : 0;
}

inline double CellView::numValue() const {
    if (cell_.kind() == CELL_NUMBER || cell_.kind() == CELL_DATETIME)
        return std::bit_cast<double>(cell_.value);
    const RareCell* rare = cell_.rare();
    return rare ? rare->numValue : 0.0;
}

inline PooledText CellView::pooledText() const {
    if (cell_.kind() == CELL_TEXT) return std::bit_cast<PooledText>(cell_.value);
    const RareCell* rare = cell_.rare();
    return rare ? rare->textValue : PooledText();
}

inline std::int32_t CellView::formatIndex() const {
    const RareCell* rare = cell_.rare();
    if (rare) return rare->formatIndex;
    return static_cast<std::int32_t>(cell_.kindAndFormat >> PackedCell::kKindBits) - 1;
}

inline CellBlocks::Place CellBlocks::placeOf(std::size_t index) {
    if (index >= kGrowing) {
        const std::size_t beyond = index - kGrowing;
        return {kDoublings + 1 + beyond / kLargest, beyond % kLargest};
    }
    const auto block = static_cast<std::size_t>(std::bit_width((index / kFirst + 1) / 2));
    return {block, index + kFirst - (kFirst << block)};
}

inline std::size_t CellBlocks::capacityOf(std::size_t block) {
    return block < kDoublings ? kFirst << block : kLargest;
}

inline PackedCell& CellBlocks::operator[](std::size_t index) const {
    const Place place = placeOf(index);
    return blocks_[place.block][place.offset];
}

inline const PackedCell* CellBlocks::endOfRun(std::size_t index) const {
    const std::size_t block = placeOf(index).block;
    return blocks_[block].get() + capacityOf(block);
}

}  // namespace dp
