#include "dpxlsx/store/cell_column.h"

#include <algorithm>
#include <utility>

#include "dpxlsx/store/text_pool.h"

namespace dp {

namespace {

// Cells filed out of order wait for the next read, but not in any number: once there are this many,
// and as many as the cells in order, they are merged. Otherwise a workbook that names the same
// cells over and over would fill the memory.
constexpr std::size_t kLateCells = 64;

// Format indices from -1 up to here are packed: 28 of the 32 bits beside the kind hold them.
constexpr std::int32_t kLargestPackedFormat = (1 << (32 - PackedCell::kKindBits)) - 2;

bool hasKind(ExternalCellType type) {
    switch (type) {
        case CELL_EMPTY:
        case CELL_INTEGER:
        case CELL_NUMBER:
        case CELL_TEXT:
        case CELL_BOOLEAN:
        case CELL_DATETIME:
            return true;
    }
    return type == kUnreadableContent;  // of which a workbook may have many
}

bool isNumber(ExternalCellType type) { return type == CELL_NUMBER || type == CELL_DATETIME; }

bool packsFormat(std::int32_t formatIndex) {
    return formatIndex >= -1 && formatIndex <= kLargestPackedFormat;
}

// Whether every field but the one named by the type has its default; a -0.0 is not the default.
bool packs(const ExternalDataRecordCell& cell) {
    const bool plainNumber = std::bit_cast<std::uint64_t>(cell.numValue) == 0;
    return (plainNumber || isNumber(cell.type)) &&
           (cell.textValue.empty() || cell.type == CELL_TEXT) &&
           (cell.intValue == 0 || cell.type == CELL_INTEGER) &&
           (cell.boolValue == 0 || cell.type == CELL_BOOLEAN) && hasKind(cell.type) &&
           packsFormat(cell.formatIndex);
}

PackedCell packed(unsigned row, std::uint32_t type, std::int32_t formatIndex, std::uint64_t value) {
    const auto format = static_cast<std::uint32_t>(formatIndex + 1);
    return {row, (format << PackedCell::kKindBits) | type, value};
}

bool byRow(const PackedCell& left, const PackedCell& right) { return left.row < right.row; }

// The first index whose row is not below `row`. `row` has 64 bits, so that it can be the one behind
// the last possible row.
std::size_t lowerIndex(const CellBlocks& cells, std::uint64_t row) {
    std::size_t first = 0;
    for (std::size_t left = cells.size(); left > 0;) {
        const std::size_t half = left / 2;
        const bool below = cells[first + half].row < row;
        first += below ? half + 1 : 0;
        left = below ? left - half - 1 : half;
    }
    return first;
}

}  // namespace

std::string_view CellView::textValue() const { return pooledText().view(); }

CellView::operator ExternalDataRecordCell() const {
    ExternalDataRecordCell cell;
    cell.type = type();
    cell.intValue = intValue();
    cell.boolValue = boolValue();
    cell.numValue = numValue();
    cell.textValue = textValue();
    cell.formatIndex = formatIndex();
    return cell;
}

CellBlocks::CellBlocks(CellBlocks&& other) noexcept
    : blocks_(std::move(other.blocks_)),
      size_(std::exchange(other.size_, 0)),
      next_(std::exchange(other.next_, nullptr)),
      end_(std::exchange(other.end_, nullptr)) {}

void CellBlocks::addBlock() {
    const std::size_t capacity = capacityOf(blocks_.size());
    blocks_.push_back(std::make_unique_for_overwrite<PackedCell[]>(capacity));
    next_ = blocks_.back().get();
    end_ = next_ + capacity;
}

void CellBlocks::truncate(std::size_t size) noexcept {
    size_ = size;
    blocks_.resize(size == 0 ? 0 : placeOf(size - 1).block + 1);
    next_ = size == 0 ? nullptr : &(*this)[size - 1] + 1;
    end_ = size == 0 ? nullptr : blocks_.back().get() + capacityOf(blocks_.size() - 1);
}

CellColumn::CellColumn(std::shared_ptr<TextPool> texts) : texts_(std::move(texts)) {}

CellColumn::CellColumn(CellColumn&& other) noexcept
    : texts_(std::move(other.texts_)),
      cells_(std::move(other.cells_)),
      sorted_(std::exchange(other.sorted_, 0)),
      rare_(std::move(other.rare_)) {}

CellColumn::~CellColumn() { settleTexts(); }

void CellColumn::settle() const {
    settleTexts();
    if (sorted_ != cells_.size()) mergeLateCells();
}

void CellColumn::settleTexts() const noexcept {
    if (texts_) texts_->settle();
}

void CellColumn::assign(unsigned row, const ExternalDataRecordCell& cell) {
    if (!packs(cell)) return assignRare(row, cell);
    const bool hasText = !cell.textValue.empty();
    if (hasText) texts()->begin(cell.textValue);
    std::uint64_t value = std::bit_cast<std::uint64_t>(cell.numValue);
    if (cell.type == CELL_INTEGER) value = static_cast<std::uint32_t>(cell.intValue);
    if (cell.type == CELL_BOOLEAN) value = static_cast<std::uint32_t>(cell.boolValue);
    PackedCell& filed = put(packed(row, cell.type, cell.formatIndex, value));
    if (hasText) texts_->deliverTo(filed.value);
}

void CellColumn::clear() noexcept {
    settleTexts();
    cells_.truncate(0);
    sorted_ = 0;
    rare_.reset();
}

const std::shared_ptr<TextPool>& CellColumn::texts() {
    if (!texts_) texts_ = std::make_shared<TextPool>();
    return texts_;
}

PackedCell& CellColumn::put(const PackedCell& cell) {
    if (!empty() && cells_.back().row == cell.row) {
        settleTexts();
        release(cells_.back());
        return cells_.back() = cell;
    }
    if (cells_.size() - sorted_ >= std::max(kLateCells, sorted_)) settle();
    const bool inOrder = sorted_ == cells_.size() && (empty() || cells_.back().row < cell.row);
    cells_.push(cell);
    if (inOrder) ++sorted_;
    return cells_.back();
}

void CellColumn::assignRare(unsigned row, const ExternalDataRecordCell& cell) {
    const PooledText text = cell.textValue.empty() ? PooledText() : texts()->intern(cell.textValue);
    if (!rare_) rare_ = std::make_unique<RareCells>();
    auto owned = std::make_unique<const RareCell>(
        RareCell{cell.type, cell.intValue, cell.boolValue, cell.numValue, text, cell.formatIndex});
    const RareCell* address = owned.get();
    rare_->emplace(address, std::move(owned));
    const PackedCell entry =
        packed(row, PackedCell::kRare, -1, std::bit_cast<std::uint64_t>(address));
    try {
        put(entry);
    } catch (...) {
        release(entry);
        throw;
    }
}

void CellColumn::release(const PackedCell& cell) const noexcept {
    if (const RareCell* rare = cell.rare()) rare_->erase(rare);
}

// The cells filed out of order, sorted by row; of several cells of a row only the one filed last.
std::vector<PackedCell> CellColumn::lateCells() const {
    std::vector<PackedCell> late;
    late.reserve(cells_.size() - sorted_);
    for (std::size_t index = sorted_; index < cells_.size(); ++index) late.push_back(cells_[index]);
    std::stable_sort(late.begin(), late.end(), byRow);
    std::size_t kept = 0;
    for (std::size_t index = 1; index < late.size(); ++index) {
        if (late[index].row == late[kept].row)
            release(late[kept]);
        else
            ++kept;
        late[kept] = late[index];
    }
    late.resize(kept + 1);
    return late;
}

// Merges from the back, so that no cell is overwritten before it has moved. Late cells replace
// those of the same rows; the gap that this leaves at the front is closed at the end.
void CellColumn::mergeLateCells() const {
    const std::vector<PackedCell> late = lateCells();
    const std::size_t end = sorted_ + late.size();
    std::size_t from = sorted_;
    std::size_t to = end;
    for (std::size_t index = late.size(); index > 0; --index) {
        const PackedCell& cell = late[index - 1];
        while (from > 0 && cells_[from - 1].row > cell.row) cells_[--to] = cells_[--from];
        if (from > 0 && cells_[from - 1].row == cell.row) release(cells_[--from]);
        cells_[--to] = cell;
    }
    for (const std::size_t gap = to - from; to < end && gap > 0; ++to) cells_[from++] = cells_[to];
    sorted_ = end - (to - from);
    cells_.truncate(sorted_);
}

std::size_t CellColumn::size() const {
    settle();
    return cells_.size();
}

CellColumn::const_iterator CellColumn::find(unsigned row) const {
    const const_iterator found = lower_bound(row);
    return found != end() && found->first == row ? found : end();
}

CellColumn::const_iterator CellColumn::lower_bound(unsigned row) const {
    settle();
    return {cells_, lowerIndex(cells_, row)};
}

CellColumn::const_iterator CellColumn::upper_bound(unsigned row) const {
    settle();
    return {cells_, lowerIndex(cells_, std::uint64_t{row} + 1)};
}

std::size_t CellColumn::count(unsigned row) const { return find(row) != end() ? 1 : 0; }

}  // namespace dp
