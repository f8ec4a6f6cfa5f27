#pragma once

#include <cstdint>

namespace dp {

// By which rules a workbook is read, as hosts choose them.
enum class ReadingRules : std::uint8_t {
    Always = 0,    // those that every host knows
    Standard = 1,  // ISO/IEC 29500, as spreadsheet programs practise it
};

}  // namespace dp
