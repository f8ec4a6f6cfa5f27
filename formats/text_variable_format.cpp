#include "dpxlsx/formats/text_variable_format.h"

#include "dpxlsx/model/string.h"

namespace dp {

TextVariableFormat::TextVariableFormat() = default;
TextVariableFormat::~TextVariableFormat() = default;

IVariableFormat::FormatType TextVariableFormat::GetType() const { return FormatType::Text; }

bool TextVariableFormat::GetAuto() const { return autoFormat; }

IString* TextVariableFormat::FormatValue(double, bool) const { return new String(); }

int TextVariableFormat::GetCharacterCount() const { return characterCount; }

}  // namespace dp
