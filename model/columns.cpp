#include "model/columns.h"

#include <algorithm>
#include <locale>
#include <string>

#include "model/reference_count.h"

namespace dp {

namespace {

// The decimal point of the environment's locale, asked for once in the life of the process.
char environmentDecimalPoint() {
    static std::string output_decimal;
    if (output_decimal.empty()) {
        const std::locale environment("");
        output_decimal.assign(1, std::use_facet<std::numpunct<char>>(environment).decimal_point());
    }
    return output_decimal[0];
}

}  // namespace

NumericColumn::~NumericColumn() = default;
TextColumn::~TextColumn() = default;

void NumericColumn::Release() {
    if (releaseReference(refCount)) delete this;
}

void TextColumn::Release() {
    if (releaseReference(refCount)) delete this;
}

IString* NumericColumn::GetFormattedValue(double value, char decimal) const {
    const IVariableFormat* shown = GetFormat();
    if (!shown) return nullptr;
    if (shown->GetType() != IVariableFormat::FormatType::Numeric)
        return shown->FormatValue(value, false);

    std::unique_ptr<IString> text(shown->FormatValue(value, true));
    const char point = environmentDecimalPoint();
    if (point == decimal) return text.release();

    std::string replaced = text->database_str();
    std::replace(replaced.begin(), replaced.end(), point, decimal);
    return new String(std::move(replaced));
}

}  // namespace dp
