#pragma once

#include "model/host/export.h"
#include "model/host/i_read_only_collection.h"
#include "model/host/i_variable.h"
#include "model/host/i_variable_format.h"

// The two interfaces through which a host finds what a provider holds. Key collections belong to
// the provider and are valid until the next query of the same kind or ClearWorksheets; constants,
// matrices and models share that of the columns. A finder that finds nothing
// answers false; objects found are new, with a reference count of 0, and owned by the caller.
namespace dp {

class IColumn;
class IConstant;
class IMatrix;
class IWorksheet;

// Models belong to the host; an import finds none. Only the code of their subtype is needed here.
class DPXLSX_API IModel {
  public:
    enum class ModelSubtype : int { Any = 0 };

    virtual ~IModel() = default;
};

class DPXLSX_API IWorksheetFinder {
  public:
    virtual ~IWorksheetFinder() = default;

    // Keys of the worksheets that are not excluded, in workbook order.
    virtual IReadOnlyCollection<int>* GetWorksheetPrimeKeys() const = 0;
    // Excluded worksheets are found too. With a null `worksheet` only tells whether the key exists.
    // An unknown key leaves `*worksheet` as it was.
    virtual bool FindWorksheet(int key, IWorksheet** worksheet) const = 0;
};

class DPXLSX_API IVariableFinder {
  public:
    virtual ~IVariableFinder() = default;

    // Keys of all columns of a worksheet, excluded ones included; empty for an unknown key.
    virtual IReadOnlyCollection<int>* GetColumnPrimeKeys(int worksheetKey) const = 0;
    // Always empty, like the next two.
    virtual IReadOnlyCollection<int>* GetConstantPrimeKeys(int worksheetKey) const = 0;
    virtual IReadOnlyCollection<int>* GetMatrixPrimeKeys(int worksheetKey) const = 0;
    virtual IReadOnlyCollection<int>* GetModelPrimeKeys(IModel::ModelSubtype subtype,
                                                        int worksheetKey) const = 0;
    // Loads a column in the kind of its first data cell, or in that of its column option. `*column`
    // is null when the key is unknown or the column is excluded and `ignoreExclusion` is false.
    virtual bool FindColumn(int key, IColumn** column, bool ignoreExclusion) const = 0;
    // Loads a column in the given kind unless a column option asks for another. `*formatType`
    // becomes the kind of its first data cell, or that of the option; it stays as it was for an
    // unknown key.
    virtual bool FindColumn(int key, IColumn** column, IVariable::StorageType storage,
                            IVariableFormat::FormatType* formatType,
                            bool ignoreExclusion) const = 0;
    // An import has none of these: false, and the out-parameter stays as it was.
    virtual bool FindConstant(int key, IConstant** constant) const = 0;
    virtual bool FindMatrix(int key, IMatrix** matrix) const = 0;
    virtual bool FindModel(int key, IModel** model) const = 0;
    virtual bool FindRegisteredSharedVariableBody(int key, IVariable** body) const = 0;
    // Accepted and ignored.
    virtual void RegisterSharedVariableBody(int key, IVariable* body) = 0;
};

}  // namespace dp
