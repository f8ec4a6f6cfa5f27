#pragma once

#include <cstdint>
#include <map>
#include <string>

#include "dpxlsx/model/host/i_data_provider.h"

// What the host asks for when a worksheet or a column is read.
namespace dp {

// A row, column or id that is not set.
inline constexpr std::uint32_t kNotSet = 0xFFFFFFFF;

// The rows of a worksheet. kNotSet in a row or count leaves the choice to the library.
struct SheetReadOptions {
    EVariableNameRowSetting variableNameRowSetting = VNR_GIVEN;
    std::uint32_t variableNameRow = kNotSet;
    std::uint32_t firstDataRow = kNotSet;
    std::uint32_t dataRowCount = kNotSet;
    bool exclude = false;
    // The two rows are still the host's 1-based numbers; the row layout makes them 0-based, once.
    bool rowsOneBased = true;
};

// One column of a worksheet.
struct ColumnReadOptions {
    std::uint32_t column = kNotSet;  // 1-based
    bool exclude = false;
    std::string name;  // used instead of the one in the sheet when not empty
    IVariable::BasicDataType columnType = IVariable::BasicDataType::NotSet;
    std::uint32_t destinationId = kNotSet;  // 1-based place at the host
};

// Options of a worksheet's columns by the host's 1-based column number.
using ColumnOptions = std::map<std::uint32_t, ColumnReadOptions>;

}  // namespace dp
