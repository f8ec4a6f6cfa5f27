#pragma once

#include <cstdint>
#include <memory>

#include "model/collections.h"
#include "model/host/i_column.h"
#include "model/host/i_variable_format.h"
#include "model/string.h"

// The columns that loading makes. Their fields are filled once and then only read; the order of the
// fields and of the operations is part of the binary contract.
namespace dp {

class DPXLSX_API ColumnView : public IColumnView {
  public:
    ColumnView() = default;

    bool GetAutoWiden() const override { return autoWiden; }
    bool GetWidthSet() const override { return widthSet; }
    bool GetHidden() const override { return hidden; }
    double GetWidth() const override { return width; }

    bool autoWiden = true;
    bool widthSet = false;
    bool hidden = false;
    double width = 0.0;
};

class DPXLSX_API ColumnOrdering : public IColumnOrdering {
  public:
    ColumnOrdering() = default;

    int GetValueOrder() const override { return valueOrder; }
    const IReadOnlyCollection<IString&>* GetOrderedTextValues() const override {
        return &orderedTextValues;
    }

    std::int32_t valueOrder = 0;
    ReadOnlyStringCollection<IString&> orderedTextValues;
};

class DPXLSX_API NumericColumn : public INumericColumn {
  public:
    static constexpr int kNumbers = 0;    // values of dataType
    static constexpr int kDateTimes = 2;  // serial day numbers

    NumericColumn() = default;
    NumericColumn(const NumericColumn&) = delete;
    NumericColumn& operator=(const NumericColumn&) = delete;
    ~NumericColumn() override;

    unsigned AddRef() override { return ++refCount; }
    void Release() override;

    int GetDataType() const override { return dataType; }
    StorageType GetStorageType() const override { return StorageType::Numeric; }
    const IString* GetName() const override { return &name; }
    const IString* GetDescription() const override { return &description; }
    int GetLastModified() const override { return lastModified; }
    int GetMissingCount() const override { return missingCount; }
    int GetRowCount() const override { return rowCount; }
    IVariableFormat* GetFormat() const override { return format.get(); }
    const IColumnView* GetView() const override { return &view; }
    bool IsFormatDirty() const override { return formatDirty; }

    const double* GetValues() const override { return values.get(); }
    int GetConvertedMissingCount() const override { return convertedMissingCount; }
    IString* GetFormattedValue(double value, char decimal) const override;

    int GetPrimeKey() const override { return primeKey; }
    void SetPrimeKey(int key) override { primeKey = key; }
    int GetVariableBodyPrimeKey() const override { return variableBodyPrimeKey; }
    void SetVariableBodyPrimeKey(int key) override { variableBodyPrimeKey = key; }
    int GetOriginalVariablePrimeKey() const override { return originalVariablePrimeKey; }
    void SetOriginalVariablePrimeKey(int key) override { originalVariablePrimeKey = key; }
    bool UseDefaultVariableBody() const override { return useDefaultVariableBody; }
    int GetType() const override { return 3; }
    int GetPosition() const override { return position; }
    int GetWorksheetId() const override { return worksheetId; }
    bool Attached() const override { return attached; }
    bool IsCopy() const override { return isCopy; }

    String name;
    String description;  // never filled
    std::int32_t primeKey = 0;
    std::int32_t variableBodyPrimeKey = 0;
    std::int32_t originalVariablePrimeKey = 0;
    std::int32_t position = 0;  // 1-based
    std::int32_t worksheetId = 0;
    std::int32_t missingCount = 0;
    std::int32_t lastModified = 0;  // never set
    std::int32_t rowCount = 0;
    std::int32_t convertedMissingCount = 0;
    bool attached = true;
    bool isCopy = false;
    bool formatDirty = false;
    bool useDefaultVariableBody = true;
    std::int32_t dataType = kNumbers;
    std::unique_ptr<double[]> values;
    std::unique_ptr<IVariableFormat> format;
    ColumnView view;
    std::uint32_t refCount = 0;
};

class DPXLSX_API TextColumn : public ITextColumn {
  public:
    TextColumn() = default;
    TextColumn(const TextColumn&) = delete;
    TextColumn& operator=(const TextColumn&) = delete;
    ~TextColumn() override;

    unsigned AddRef() override { return ++refCount; }
    void Release() override;

    int GetDataType() const override { return 4; }
    StorageType GetStorageType() const override { return StorageType::Text; }
    const IString* GetName() const override { return &name; }
    const IString* GetDescription() const override { return &description; }
    int GetLastModified() const override { return lastModified; }
    int GetMissingCount() const override { return missingCount; }
    int GetRowCount() const override { return rowCount; }
    IVariableFormat* GetFormat() const override { return format.get(); }
    const IColumnView* GetView() const override { return &view; }
    bool IsFormatDirty() const override { return formatDirty; }

    const IReadOnlyCollection<IString&>* GetTextValues() const override { return &textValues; }
    const IColumnOrdering* GetOrdering() const override { return &ordering; }

    int GetPrimeKey() const override { return primeKey; }
    void SetPrimeKey(int key) override { primeKey = key; }
    int GetVariableBodyPrimeKey() const override { return variableBodyPrimeKey; }
    void SetVariableBodyPrimeKey(int key) override { variableBodyPrimeKey = key; }
    int GetOriginalVariablePrimeKey() const override { return originalVariablePrimeKey; }
    void SetOriginalVariablePrimeKey(int key) override { originalVariablePrimeKey = key; }
    bool UseDefaultVariableBody() const override { return useDefaultVariableBody; }
    int GetType() const override { return 3; }
    int GetPosition() const override { return position; }
    int GetWorksheetId() const override { return worksheetId; }
    bool Attached() const override { return attached; }
    bool IsCopy() const override { return isCopy; }

    String name;
    String description;  // never filled
    std::int32_t primeKey = 0;
    std::int32_t variableBodyPrimeKey = 0;
    std::int32_t originalVariablePrimeKey = 0;
    std::int32_t position = 0;  // 1-based
    std::int32_t worksheetId = 0;
    std::int32_t missingCount = 0;
    std::int32_t lastModified = 0;  // never set
    std::int32_t rowCount = 0;
    bool attached = true;
    bool isCopy = false;
    bool formatDirty = false;
    bool useDefaultVariableBody = true;
    ReadOnlyStringCollection<IString&> textValues;
    ColumnOrdering ordering;
    std::unique_ptr<IVariableFormat> format;
    ColumnView view;
    std::uint32_t refCount = 0;
};

}  // namespace dp
