#pragma once

#include "export.h"
#include "i_read_only_collection.h"
#include "i_variable.h"
#include "i_variable_format.h"

// The two interfaces through which a host finds what a provider holds. Key collections belong to
// the provider and are never null; their content is valid until the next query of the same kind or
// ClearWorksheets, and constants, matrices and models share the collection of the columns. A finder
// that finds nothing returns false. Objects found are new on every call, with a reference count of
// 0: the caller takes the first reference. Where memory runs out, std::bad_alloc is thrown.
namespace dp {

class IColumn;
class IConstant;
class IMatrix;
class IWorksheet;

// Models belong to the host; an import finds none. Only the code of their subtype is needed here.
class DPXLSX_API IModel {
  public:
    // The host's codes; the library looks at none of them.
    enum class ModelSubtype : int { Any = 0 };

    virtual ~IModel() = default;
};

// The worksheets. Their keys are 1, 2, 3 ... in the order of the workbook, going on from file to
// file until ClearWorksheets. Worksheets without a cell are left out, so keys may have gaps.
class DPXLSX_API IWorksheetFinder {
  public:
    virtual ~IWorksheetFinder() = default;

    // Keys of the worksheets that are not excluded, ascending. Also decides for each of these, by
    // the read options given so far, where its names and data are: to be called after opening and
    // setting options, before the first column is loaded.
    virtual IReadOnlyCollection<int>* GetWorksheetPrimeKeys() const = 0;
    // Excluded worksheets are found too. With a null `worksheet` only tells whether the key exists.
    // An unknown key leaves `*worksheet` as it was.
    virtual bool FindWorksheet(int key, IWorksheet** worksheet) const = 0;
};

// The columns: those of a worksheet that hold at least one cell. Their keys are 1, 2, 3 ... over
// all worksheets, from left to right in each, whatever is excluded; a key is no place in the sheet.
//
// Columns are loaded after GetWorksheetPrimeKeys and before CloseFile. Before the former they hold
// no values, and loading one fixes its worksheet's setting of the name row at VNR_GIVEN, whatever
// SetReadOptionDefaultUseVariableNameRow says; after the latter date-times arrive as numbers.
class DPXLSX_API IVariableFinder {
  public:
    virtual ~IVariableFinder() = default;

    // Keys of all columns of a worksheet, ascending, excluded ones included; empty for an unknown
    // key.
    virtual IReadOnlyCollection<int>* GetColumnPrimeKeys(int worksheetKey) const = 0;

    // --- Always empty ---
    virtual IReadOnlyCollection<int>* GetConstantPrimeKeys(int worksheetKey) const = 0;
    virtual IReadOnlyCollection<int>* GetMatrixPrimeKeys(int worksheetKey) const = 0;
    virtual IReadOnlyCollection<int>* GetModelPrimeKeys(IModel::ModelSubtype subtype,
                                                        int worksheetKey) const = 0;

    // Loads a column in the kind that its column option asks for, else in that of its first data
    // cell. False, and a null `*column`, for an unknown key, and for an excluded column unless
    // `ignoreExclusion`. With a null `column` it loads nothing and returns the same.
    virtual bool FindColumn(int key, IColumn** column, bool ignoreExclusion) const = 0;
    // The same in the given kind unless a column option asks for another. `*formatType` becomes the
    // kind of the first data cell; under an option that asks for a kind it is Text or Numeric, the
    // latter for date-times too (GetDataType tells). Without a data cell and such an option it is
    // what `storage` says. An unknown key leaves it as it was; it may be null.
    virtual bool FindColumn(int key, IColumn** column, IVariable::StorageType storage,
                            IVariableFormat::FormatType* formatType,
                            bool ignoreExclusion) const = 0;

    // --- An import has none of these: false, and the out-parameter stays as it was ---
    virtual bool FindConstant(int key, IConstant** constant) const = 0;
    virtual bool FindMatrix(int key, IMatrix** matrix) const = 0;
    virtual bool FindModel(int key, IModel** model) const = 0;
    virtual bool FindRegisteredSharedVariableBody(int key, IVariable** body) const = 0;

    // Accepted and ignored; the body stays the caller's.
    virtual void RegisterSharedVariableBody(int key, IVariable* body) = 0;
};

}  // namespace dp
