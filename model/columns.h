#pragma once

#include <cstdint>
#include <memory>

#include "dpxlsx/model/collections.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_variable_format.h"
#include "dpxlsx/model/string.h"

// The columns that loading makes. A getter returns the field of its name where there is one. A load
// fills the fields; afterwards only the setters of keys change any. The order of the fields and of
// the operations is part of the binary contract.
namespace dp {

class DPXLSX_API ColumnView : public IColumnView {
  public:
    ColumnView();
    ~ColumnView() override;

    bool GetAutoWiden() const override;
    bool GetWidthSet() const override;
    bool GetHidden() const override;
    double GetWidth() const override;

    bool autoWiden = true;
    bool widthSet = false;
    bool hidden = false;
    double width = 0.0;
};

class DPXLSX_API ColumnOrdering : public IColumnOrdering {
  public:
    ColumnOrdering();
    ~ColumnOrdering() override;

    int GetValueOrder() const override;
    const IReadOnlyCollection<IString&>* GetOrderedTextValues() const override;

    std::int32_t valueOrder = 0;
    ReadOnlyStringCollection<IString&> orderedTextValues;
};

class DPXLSX_API NumericColumn : public INumericColumn {
  public:
    static constexpr int kNumbers = 0;    // values of dataType
    static constexpr int kDateTimes = 2;  // serial day numbers

    NumericColumn();
    NumericColumn(const NumericColumn&) = delete;
    NumericColumn& operator=(const NumericColumn&) = delete;
    ~NumericColumn() override;

    unsigned AddRef() override;
    void Release() override;

    int GetDataType() const override;
    StorageType GetStorageType() const override;
    const IString* GetName() const override;
    const IString* GetDescription() const override;
    int GetLastModified() const override;
    int GetMissingCount() const override;
    int GetRowCount() const override;
    IVariableFormat* GetFormat() const override;
    const IColumnView* GetView() const override;
    bool IsFormatDirty() const override;

    const double* GetValues() const override;
    int GetConvertedMissingCount() const override;
    IString* GetFormattedValue(double value, char decimal) const override;

    int GetPrimeKey() const override;
    void SetPrimeKey(int key) override;
    int GetVariableBodyPrimeKey() const override;
    void SetVariableBodyPrimeKey(int key) override;
    int GetOriginalVariablePrimeKey() const override;
    void SetOriginalVariablePrimeKey(int key) override;
    bool UseDefaultVariableBody() const override;
    int GetType() const override;
    int GetPosition() const override;
    int GetWorksheetId() const override;
    bool Attached() const override;
    bool IsCopy() const override;

    String name;
    String description;  // never filled
    std::int32_t primeKey = 0;
    std::int32_t variableBodyPrimeKey = 0;
    std::int32_t originalVariablePrimeKey = 0;  // never set by a load
    std::int32_t position = 0;                  // 1-based
    std::int32_t worksheetId = 0;               // never set
    std::int32_t missingCount = 0;
    std::int32_t lastModified = 0;  // never set
    std::int32_t rowCount = 0;
    std::int32_t convertedMissingCount = 0;
    bool attached = true;
    bool isCopy = false;
    bool formatDirty = false;
    bool useDefaultVariableBody = true;
    std::int32_t dataType = kNumbers;         // or kDateTimes
    std::unique_ptr<double[]> values;         // at least rowCount; null until the load
    std::unique_ptr<IVariableFormat> format;  // null until the load
    ColumnView view;
    std::uint32_t refCount = 0;
};

class DPXLSX_API TextColumn : public ITextColumn {
  public:
    TextColumn();
    TextColumn(const TextColumn&) = delete;
    TextColumn& operator=(const TextColumn&) = delete;
    ~TextColumn() override;

    unsigned AddRef() override;
    void Release() override;

    int GetDataType() const override;
    StorageType GetStorageType() const override;
    const IString* GetName() const override;
    const IString* GetDescription() const override;
    int GetLastModified() const override;
    int GetMissingCount() const override;
    int GetRowCount() const override;
    IVariableFormat* GetFormat() const override;
    const IColumnView* GetView() const override;
    bool IsFormatDirty() const override;

    const IReadOnlyCollection<IString&>* GetTextValues() const override;
    const IColumnOrdering* GetOrdering() const override;

    int GetPrimeKey() const override;
    void SetPrimeKey(int key) override;
    int GetVariableBodyPrimeKey() const override;
    void SetVariableBodyPrimeKey(int key) override;
    int GetOriginalVariablePrimeKey() const override;
    void SetOriginalVariablePrimeKey(int key) override;
    bool UseDefaultVariableBody() const override;
    int GetType() const override;
    int GetPosition() const override;
    int GetWorksheetId() const override;
    bool Attached() const override;
    bool IsCopy() const override;

    String name;
    String description;  // never filled
    std::int32_t primeKey = 0;
    std::int32_t variableBodyPrimeKey = 0;
    std::int32_t originalVariablePrimeKey = 0;  // never set by a load
    std::int32_t position = 0;                  // 1-based
    std::int32_t worksheetId = 0;               // never set
    std::int32_t missingCount = 0;
    std::int32_t lastModified = 0;  // never set
    std::int32_t rowCount = 0;
    bool attached = true;
    bool isCopy = false;
    bool formatDirty = false;
    bool useDefaultVariableBody = true;
    ReadOnlyStringCollection<IString&> textValues;  // rowCount texts
    ColumnOrdering ordering;
    std::unique_ptr<IVariableFormat> format;  // null until the load
    ColumnView view;
    std::uint32_t refCount = 0;
};

}  // namespace dp
