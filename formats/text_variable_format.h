#pragma once

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// The format of text columns. Text values are shown as they are, so a number has no display.
class DPXLSX_API TextVariableFormat : public ITextVariableFormat {
  public:
    TextVariableFormat();
    ~TextVariableFormat() override;

    FormatType GetType() const override;
    bool GetAuto() const override;
    // A new string, always empty.
    IString* FormatValue(double value, bool fullPrecision) const override;
    int GetCharacterCount() const override;

    bool autoFormat = false;
    int characterCount = 0;  // bytes
};

}  // namespace dp
