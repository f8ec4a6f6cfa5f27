#pragma once

#include <memory>

#include "dpxlsx/formats/numeric_variable_format.h"

namespace dp {

// The format of numbers whose style says nothing about their display.
inline std::unique_ptr<NumericVariableFormat> createAutomaticFormat() {
    auto format = std::make_unique<NumericVariableFormat>();
    format->autoFormat = true;
    return format;
}

}  // namespace dp
