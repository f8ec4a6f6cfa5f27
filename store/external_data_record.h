#pragma once

#include <cstdint>
#include <string>

#include "dpxlsx/model/host/export.h"

namespace dp {

// What a cell holds. Values without a name here are legal and count as empty.
enum ExternalCellType : std::uint32_t {
    CELL_EMPTY = 0,
    CELL_INTEGER = 3,
    CELL_NUMBER = 4,
    CELL_TEXT = 5,
    CELL_BOOLEAN = 6,
    CELL_DATETIME = 8
};

// By the standard cells without a value are filed too: errors as CELL_EMPTY, and content that is
// not what the cell's type says as this type, which has no name and holds nothing.
inline constexpr ExternalCellType kUnreadableContent{1};

// The content of one worksheet cell: `type` names the field that holds its value.
class DPXLSX_API ExternalDataRecordCell {
  public:
    ExternalDataRecordCell();
    ExternalDataRecordCell(const ExternalDataRecordCell& other);
    ExternalDataRecordCell(ExternalDataRecordCell&& other) noexcept = default;
    ExternalDataRecordCell& operator=(const ExternalDataRecordCell& other);
    ExternalDataRecordCell& operator=(ExternalDataRecordCell&& other) noexcept = default;
    ~ExternalDataRecordCell();

    // Puts every field back to its default.
    void initialize();

    ExternalCellType type = CELL_EMPTY;
    std::int32_t intValue = 0;
    std::int32_t boolValue = 0;     // non-zero is true
    double numValue = 0.0;          // a number, or the serial day number of a date-time
    std::string textValue;          // UTF-8
    std::int32_t formatIndex = -1;  // position in the reader's style table, -1 without style
};

// One cell and its place in the worksheet, as readers deliver it.
class DPXLSX_API ExternalDataRecord {
  public:
    ExternalDataRecord(unsigned reserved0, unsigned reserved1, unsigned row, unsigned column);
    ExternalDataRecord(const ExternalDataRecord& other);
    ExternalDataRecord(ExternalDataRecord&& other) noexcept = default;
    ExternalDataRecord& operator=(const ExternalDataRecord& other);
    ExternalDataRecord& operator=(ExternalDataRecord&& other) noexcept = default;
    ~ExternalDataRecord();

    // Sets the four numbers to 0 and the cell to its defaults.
    void initialize();

    std::uint32_t reserved0;  // readers set 0, and nothing reads it
    std::uint32_t reserved1;  // readers set 0, and nothing reads it
    std::uint32_t row;        // 0-based
    std::uint32_t column;     // 0-based
    ExternalDataRecordCell cell;
};

}  // namespace dp
