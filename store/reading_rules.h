#pragma once

#include <cstdint>

namespace dp {

// By which rules a workbook is read, as hosts choose them.
enum class ReadingRules : std::uint8_t {
    Default = 0,   // until a host asks for others
    Standard = 1,  // ISO/IEC 29500, as spreadsheet programs practise it
};

}  // namespace dp
