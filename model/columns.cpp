#include "dpxlsx/model/columns.h"

#include <langinfo.h>
#include <locale.h>

#include <algorithm>
#include <string>
#include <utility>

#include "dpxlsx/model/reference_count.h"

namespace dp {

namespace {

// The decimal point of the environment's locale, determined once per process. Only LC_NUMERIC
// counts; when its locale is not installed, the result is ".".
char environmentDecimalPoint() {
    static const char output_decimal = [] {
        const locale_t numbers = newlocale(LC_NUMERIC_MASK, "", nullptr);
        const char point = numbers ? *nl_langinfo_l(RADIXCHAR, numbers) : '.';
        if (numbers) freelocale(numbers);
        return point;
    }();
    return output_decimal;
}

}  // namespace

ColumnView::ColumnView() = default;
ColumnView::~ColumnView() = default;

bool ColumnView::GetAutoWiden() const { return autoWiden; }
bool ColumnView::GetWidthSet() const { return widthSet; }
bool ColumnView::GetHidden() const { return hidden; }
double ColumnView::GetWidth() const { return width; }

ColumnOrdering::ColumnOrdering() = default;
ColumnOrdering::~ColumnOrdering() = default;

int ColumnOrdering::GetValueOrder() const { return valueOrder; }
const IReadOnlyCollection<IString&>* ColumnOrdering::GetOrderedTextValues() const {
    return &orderedTextValues;
}

NumericColumn::NumericColumn() = default;
NumericColumn::~NumericColumn() = default;

unsigned NumericColumn::AddRef() { return ++refCount; }
int NumericColumn::GetDataType() const { return dataType; }
IVariable::StorageType NumericColumn::GetStorageType() const { return StorageType::Numeric; }
const IString* NumericColumn::GetName() const { return &name; }
const IString* NumericColumn::GetDescription() const { return &description; }
int NumericColumn::GetLastModified() const { return lastModified; }
int NumericColumn::GetMissingCount() const { return missingCount; }
int NumericColumn::GetRowCount() const { return rowCount; }
IVariableFormat* NumericColumn::GetFormat() const { return format.get(); }
const IColumnView* NumericColumn::GetView() const { return &view; }
bool NumericColumn::IsFormatDirty() const { return formatDirty; }
const double* NumericColumn::GetValues() const { return values.get(); }
int NumericColumn::GetConvertedMissingCount() const { return convertedMissingCount; }
int NumericColumn::GetPrimeKey() const { return primeKey; }
void NumericColumn::SetPrimeKey(int key) { primeKey = key; }
int NumericColumn::GetVariableBodyPrimeKey() const { return variableBodyPrimeKey; }
void NumericColumn::SetVariableBodyPrimeKey(int key) { variableBodyPrimeKey = key; }
int NumericColumn::GetOriginalVariablePrimeKey() const { return originalVariablePrimeKey; }
void NumericColumn::SetOriginalVariablePrimeKey(int key) { originalVariablePrimeKey = key; }
bool NumericColumn::UseDefaultVariableBody() const { return useDefaultVariableBody; }
int NumericColumn::GetType() const { return 3; }
int NumericColumn::GetPosition() const { return position; }
int NumericColumn::GetWorksheetId() const { return worksheetId; }
bool NumericColumn::Attached() const { return attached; }
bool NumericColumn::IsCopy() const { return isCopy; }

void NumericColumn::Release() {
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

TextColumn::TextColumn() = default;
TextColumn::~TextColumn() = default;

unsigned TextColumn::AddRef() { return ++refCount; }
int TextColumn::GetDataType() const { return 4; }
IVariable::StorageType TextColumn::GetStorageType() const { return StorageType::Text; }
const IString* TextColumn::GetName() const { return &name; }
const IString* TextColumn::GetDescription() const { return &description; }
int TextColumn::GetLastModified() const { return lastModified; }
int TextColumn::GetMissingCount() const { return missingCount; }
int TextColumn::GetRowCount() const { return rowCount; }
IVariableFormat* TextColumn::GetFormat() const { return format.get(); }
const IColumnView* TextColumn::GetView() const { return &view; }
bool TextColumn::IsFormatDirty() const { return formatDirty; }
const IReadOnlyCollection<IString&>* TextColumn::GetTextValues() const { return &textValues; }
const IColumnOrdering* TextColumn::GetOrdering() const { return &ordering; }
int TextColumn::GetPrimeKey() const { return primeKey; }
void TextColumn::SetPrimeKey(int key) { primeKey = key; }
int TextColumn::GetVariableBodyPrimeKey() const { return variableBodyPrimeKey; }
void TextColumn::SetVariableBodyPrimeKey(int key) { variableBodyPrimeKey = key; }
int TextColumn::GetOriginalVariablePrimeKey() const { return originalVariablePrimeKey; }
void TextColumn::SetOriginalVariablePrimeKey(int key) { originalVariablePrimeKey = key; }
bool TextColumn::UseDefaultVariableBody() const { return useDefaultVariableBody; }
int TextColumn::GetType() const { return 3; }
int TextColumn::GetPosition() const { return position; }
int TextColumn::GetWorksheetId() const { return worksheetId; }
bool TextColumn::Attached() const { return attached; }
bool TextColumn::IsCopy() const { return isCopy; }

void TextColumn::Release() {
    if (releaseReference(refCount)) delete this;
}

}  // namespace dp
