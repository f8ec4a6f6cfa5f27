#include "dpxlsx/store/worksheet_cells.h"

#include <algorithm>
#include <cassert>
#include <iterator>
#include <utility>

#include "dpxlsx/store/text_pool.h"

namespace dp {

WorksheetCells::WorksheetCells(std::shared_ptr<TextPool> texts) : texts_(std::move(texts)) {}

WorksheetCells::WorksheetCells(WorksheetCells&& other) noexcept { *this = std::move(other); }

WorksheetCells& WorksheetCells::operator=(WorksheetCells&& other) noexcept {
    if (this == &other) return *this;
    texts_ = std::move(other.texts_);
    columns_ = std::move(other.columns_);
    recent_ = other.recent_;
    inOrder_ = std::move(other.inOrder_);
    other.clear();
    return *this;
}

WorksheetCells::~WorksheetCells() = default;

void WorksheetCells::add(const ExternalDataRecord& record) {
    file(record.column, [&](CellColumn& cells) { cells.assign(record.row, record.cell); });
}

CellColumn& WorksheetCells::operator[](unsigned column) {
    file(column, [](CellColumn&) {});
    return recent_->second;
}

void WorksheetCells::clear() noexcept {
    columns_.clear();
    recent_ = {};
    inOrder_.clear();
}

const std::shared_ptr<TextPool>& WorksheetCells::texts() {
    if (!texts_) texts_ = std::make_shared<TextPool>();
    return texts_;
}

const WorksheetCells::value_type& WorksheetCells::nth(std::size_t position) const {
    assert(position < size());
    return *inOrder()[position];
}

std::uint64_t WorksheetCells::rowCount() const {
    std::uint64_t count = 0;
    for (const auto& [number, cells] : columns_)
        if (!cells.empty()) count = std::max(count, std::uint64_t{cells.rbegin()->first} + 1);
    return count;
}

void WorksheetCells::settle() const {
    for (const auto& [number, cells] : columns_) cells.settle();
    inOrder();
}

// The column's cells, null if there are none.
CellColumn* WorksheetCells::known(unsigned column) {
    if (columns_.empty()) return nullptr;
    if (recent_->first != column) {
        auto found = recent_->first < column ? std::next(recent_) : columns_.begin();
        if (found == columns_.end() || found->first != column) found = columns_.find(column);
        if (found == columns_.end()) return nullptr;
        recent_ = found;
    }
    return &recent_->second;
}

// A new column is inserted together with its first cell, so that a failure leaves no empty column
// behind.
template <typename File>
void WorksheetCells::file(unsigned column, const File& fileIn) {
    if (CellColumn* cells = known(column)) return fileIn(*cells);
    CellColumn cells(texts());
    fileIn(cells);
    recent_ = columns_.emplace(column, std::move(cells)).first;
}

const std::vector<const WorksheetCells::value_type*>& WorksheetCells::inOrder() const {
    if (inOrder_.size() != columns_.size()) {
        std::vector<const value_type*> inOrder;
        inOrder.reserve(columns_.size());
        for (const value_type& column : columns_) inOrder.push_back(&column);
        inOrder_ = std::move(inOrder);
    }
    return inOrder_;
}

}  // namespace dp
