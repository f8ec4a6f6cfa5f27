#include <algorithm>
#include <limits>
#include <memory>
#include <utility>

#include "dpxlsx/model/string.h"
#include "dpxlsx/model/worksheet.h"
#include "dpxlsx/provider/excel_data_provider_base.h"
#include "dpxlsx/store/text_cleaning.h"
#include "dpxlsx/store/text_pool.h"

// The worksheets that a reader announced: names, keys, positions, and their cells.
namespace dp {

namespace {

template <class Items>
bool isPosition(int position, const Items& items) {
    return position >= 0 && static_cast<std::size_t>(position) < items.size();
}

template <class Items>
void eraseAt(Items& items, int position) {
    items.erase(items.begin() + position);
}

template <class Items>
void makeRoomForOne(Items& items) {
    if (items.size() == items.capacity()) items.reserve(2 * items.size() + 1);
}

}  // namespace

void ExcelDataProviderBase::AddWorksheet(const char* name) {
    std::string title = textOrEmpty(name);
    if (_cleanWorksheetNames) CleanWorksheetName(title);

    // Never a key in use: after a removal there may be fewer names than the largest key.
    std::vector<int>& keys = _allWorksheetKeys.items;
    const int count = static_cast<int>(_worksheetNames.size()) + 1;
    const int key = keys.empty() ? count : std::max(count, keys.back() + 1);

    // Reserves memory first, so that nothing can fail between the three additions.
    makeRoomForOne(_worksheetNames);
    makeRoomForOne(_cells);
    makeRoomForOne(keys);
    // All worksheets share one pool, so that equal texts are kept once; it is destroyed with the
    // last worksheet.
    const std::shared_ptr<TextPool> texts =
        _cells.empty() ? std::make_shared<TextPool>() : _cells.back().texts();
    _worksheetNames.push_back(std::move(title));
    _cells.emplace_back(texts);
    keys.push_back(key);
}

void ExcelDataProviderBase::RemoveWorksheet(int position) {
    if (!isPosition(position, _worksheetNames)) return;
    // The key may be assigned again, to a worksheet with other rows.
    const auto key = static_cast<unsigned>(GetWorksheetPrimeKey(static_cast<unsigned>(position)));
    _lastRows.erase(key);
    _blankRows.erase(key);
    eraseAt(_worksheetNames, position);
    eraseAt(_cells, position);
    eraseAt(_allWorksheetKeys.items, position);
    if (!_cells.empty()) _cells.back().columnsBefore.reset();
}

void ExcelDataProviderBase::SetWorksheetIndex(int position) { _worksheetIndex = position; }

void ExcelDataProviderBase::AddExternalDataRecord(const ExternalDataRecord& record) {
    if (!isPosition(_worksheetIndex, _cells)) return;
    WorksheetCells& cells = _cells[static_cast<std::size_t>(_worksheetIndex)];
    const std::size_t columns = cells.size();
    cells.add(record);
    if (cells.size() != columns) _cells.back().columnsBefore.reset();
}

unsigned ExcelDataProviderBase::GetColumnCount(int worksheet) const {
    if (!isPosition(worksheet, _worksheetColumns)) return 0;
    return static_cast<unsigned>(_worksheetColumns[static_cast<std::size_t>(worksheet)].size());
}

IColumn* ExcelDataProviderBase::GetColumn(int worksheet, int column) const {
    if (!isPosition(worksheet, _worksheetColumns)) return nullptr;
    const auto& columns = _worksheetColumns[static_cast<std::size_t>(worksheet)];
    return isPosition(column, columns) ? columns[static_cast<std::size_t>(column)] : nullptr;
}

unsigned ExcelDataProviderBase::GetWorksheetRowCount(unsigned key) const {
    return static_cast<unsigned>(cellsOf(key).rowCount());
}

IReadOnlyCollection<int>* ExcelDataProviderBase::GetWorksheetPrimeKeys() const {
    std::vector<int> included;
    for (const int key : _allWorksheetKeys.items)
        if (!isExcluded(static_cast<unsigned>(key))) included.push_back(key);
    _worksheetKeys.items = std::move(included);
    for (const int key : _worksheetKeys.items) {
        CalculateRowOffsets(static_cast<unsigned>(key));
        FindLastRow(static_cast<unsigned>(key));
        FindBlankRows(static_cast<unsigned>(key));
    }
    return &_worksheetKeys;
}

bool ExcelDataProviderBase::FindWorksheet(int key, IWorksheet** worksheet) const {
    const std::vector<int>& keys = _allWorksheetKeys.items;
    if (!std::binary_search(keys.begin(), keys.end(), key)) return false;
    if (!worksheet) return true;
    auto found = std::make_unique<Worksheet>();
    found->primeKey = key;
    found->title = _worksheetNames[GetWorksheetPosition(static_cast<unsigned>(key))];
    *worksheet = found.release();
    return true;
}

int ExcelDataProviderBase::GetWorksheetPrimeKey(unsigned position) const {
    const std::vector<int>& keys = _allWorksheetKeys.items;
    return position < keys.size() ? keys[position] : 0;
}

unsigned ExcelDataProviderBase::GetWorksheetPosition(unsigned key) const {
    // Keys only grow and removal keeps their order.
    const std::vector<int>& keys = _allWorksheetKeys.items;
    const auto position = std::partition_point(
        keys.begin(), keys.end(), [key](int other) { return static_cast<unsigned>(other) < key; });
    return static_cast<unsigned>(position - keys.begin());
}

std::string ExcelDataProviderBase::GetWorksheetName(int position) const {
    if (!isPosition(position, _worksheetNames)) return {};
    return _worksheetNames[static_cast<std::size_t>(position)];
}

int ExcelDataProviderBase::GetWorksheetCount() const {
    return static_cast<int>(_worksheetColumns.size());
}

bool ExcelDataProviderBase::worksheetExists(unsigned key) const {
    return key <= static_cast<unsigned>(std::numeric_limits<int>::max()) &&
           FindWorksheet(static_cast<int>(key), nullptr);
}

const WorksheetCells& ExcelDataProviderBase::cellsOf(unsigned key) const {
    static const WorksheetCells none;
    return worksheetExists(key) ? _cells[GetWorksheetPosition(key)] : none;
}

}  // namespace dp
