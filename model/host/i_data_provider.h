#pragma once

#include <string>
#include <vector>

#include "model/host/export.h"
#include "model/host/i_resource.h"
#include "model/host/i_variable.h"

// The provider as the host sees it. The order of the operations is the binary contract: hosts call
// through the table of virtual functions, so nothing here is ever moved, inserted or removed.
//
// Result codes: 0 success, -1 failure, -50 not supported; for opening also -17 (no such file),
// -18 (temporary directory), -22 (not a workbook's name or not a package), -25 (not a workbook).
// Keys are worksheet prime keys; row and column numbers of the options are the sheet's own,
// 1-based. A null text counts as the empty text.
namespace dp {

class IAnalysis;
class IColumn;
class ICustomDesign;
class IDDELink;
class IDOEReader;
class IDateTimeVariableFormat;
class IDesign;
class IFactorialPlot;
class IFormulaNode;
class IMatrix;
class IMixturePlot;
class IMixtureResponseModelCollection;
class IModel;
class IMultipleResponseOptimization;
class INumericColumn;
class INumericConstant;
class IResponseModels;
class ITaguchiAnalysis;
class ITaguchiDesign;
class ITaguchiPrediction;
class ITextColumn;
class ITextConstant;
class IVariabilityDataCollection;
class IVariableFinder;
class IWorksheet;
class IWorksheetFinder;
class ExternalDataRecord;

// How the row that holds the variable names is found.
enum EVariableNameRowSetting : unsigned {
    VNR_NONE = 0,   // there is none
    VNR_GIVEN = 1,  // a row that the host gives, the first one by default
    VNR_INFER = 2   // the first row when it holds texts and no number or date-time
};

class DPXLSX_API IDataProvider : public IResource {
  public:
    enum class FileAccess : int { Read = 0, Write = 1 };

    // --- 4-6: opening, listing and closing a file ---
    // The worksheet names of a file in workbook order, without reading its cells. Not to be called
    // while a file is open.
    virtual long GetWorksheets(const char* fileName, std::vector<std::string>& names) = 0;
    // Reads a whole workbook into the provider. Errors in its XML and of the file system leave as
    // exceptions; the provider stays usable.
    virtual long OpenFile(const char* fileName, FileAccess access) = 0;
    // Removes what opening left on disk; cells and settings stay. Always 0.
    virtual long CloseFile() = 0;

    // --- 7-27: write side, not supported: -50, nothing changes ---
    virtual long AddWorksheet(IWorksheet* worksheet) = 0;
    virtual long AddDesign(IDesign* design) = 0;
    virtual long AddTaguchiDesign(ITaguchiDesign* design) = 0;
    virtual long AddTaguchiAnalysis(ITaguchiAnalysis* analysis) = 0;
    virtual long AddTaguchiPrediction(ITaguchiPrediction* prediction) = 0;
    virtual long AddAnalysis(IAnalysis* analysis) = 0;
    virtual long AddResponseModels(IResponseModels* models) = 0;
    virtual long AddVariabilityDataCollection(IVariabilityDataCollection* collection) = 0;
    virtual long AddMultipleResponseOptimization(IMultipleResponseOptimization* optimization) = 0;
    virtual long AddMixtureResponseModelCollection(IMixtureResponseModelCollection* models) = 0;
    virtual long AddColumn(INumericColumn* column) = 0;
    virtual long AddColumn(ITextColumn* column) = 0;
    virtual long AddConstant(INumericConstant* constant) = 0;
    virtual long AddConstant(ITextConstant* constant) = 0;
    virtual long AddMatrix(IMatrix* matrix) = 0;
    virtual long AddModel(IModel* model) = 0;
    virtual long AddFactorialPlot(IFactorialPlot* plot) = 0;
    virtual long AddMixturePlot(IMixturePlot* plot) = 0;
    virtual long AddCustomDesign(ICustomDesign* design) = 0;
    virtual long AddFormulaNode(IFormulaNode* node) = 0;
    virtual long AddDDELink(IDDELink* link) = 0;

    // --- 28-30: what the provider offers; owned by the provider ---
    virtual IWorksheetFinder* GetWorksheetFinder() = 0;
    virtual IVariableFinder* GetVariableFinder() = 0;
    // Null: an import has no designs.
    virtual IDOEReader* GetDOEReader() = 0;

    // --- 31-43: settings; the first nine are shared by all providers of the process ---
    // The number that marks a missing value in every column.
    virtual void SetMissingValue(double value) = 0;
    virtual void SetMissingValueTextRepresentation(const char* text) = 0;
    // Numbers outside [minimum, maximum] become missing.
    virtual void SetNumericRange(double minimum, double maximum) = 0;
    // Bytes.
    virtual void SetMaximumTextLength(int length) = 0;
    virtual void SetInputDecimal(char symbol) = 0;
    virtual void SetOutputDecimal(char symbol) = 0;
    virtual void SetOutputGroupingSymbol(char symbol) = 0;
    virtual void SetBooleanTrueValue(const char* text) = 0;
    virtual void SetBooleanFalseValue(const char* text) = 0;
    virtual void SetWriteOptionVariableNames(bool write) = 0;
    // Texts equal to `from` become `to`.
    virtual void SetMissingText(const char* from, const char* to) = 0;
    // Numbers equal to `from` become `to`.
    virtual void SetMissingNumeric(double from, double to) = 0;
    // In numeric columns, cells with the text `from` become `to`, in place of what
    // SetMissingNumeric asks for; an empty text switches this off. `to` replaces that of
    // SetMissingNumeric.
    virtual void SetAlphaMissingNumeric(const char* from, double to) = 0;

    // --- 44-46: accepted and ignored ---
    virtual void SetFieldDelimiter(char symbol) = 0;
    virtual void SetTextDelimiter(char symbol) = 0;
    virtual void SetDecimalSeparator(char symbol) = 0;

    // --- 47-52: read options of the whole file ---
    virtual void SetReadOptionIgnoreBlankRows(bool ignore) = 0;
    virtual void SetReadOptionPadColumnsWithMissingValues(bool pad) = 0;
    virtual void SetReadOptionCleanTextValues(bool clean) = 0;
    // Accepted and ignored.
    virtual void SetReadOptionFoldTextValues(bool fold) = 0;
    virtual void SetReadOptionCleanWorksheetNames(bool clean) = 0;
    virtual void SetReadOptionConvertDateTimeToText(bool convert) = 0;

    // --- 53-56: read options per worksheet ---
    // A row of 0 means not given.
    virtual void SetReadOptionDataRowPositions(unsigned key, EVariableNameRowSetting setting,
                                               unsigned nameRow, unsigned firstRow) = 0;
    virtual void SetReadOptionDefaultUseVariableNameRow(EVariableNameRowSetting setting) = 0;
    virtual void SetReadOptionDataRowCount(unsigned key, unsigned count) = 0;
    virtual void SetReadOptionExclude(unsigned key, bool exclude) = 0;

    // --- 57-61: read options per column ---
    virtual void SetReadColumnOptionExclude(unsigned key, unsigned column, bool exclude) = 0;
    virtual void SetReadColumnOptionColumnType(unsigned key, unsigned column,
                                               IVariable::BasicDataType type) = 0;
    virtual void SetReadColumnOptionName(unsigned key, unsigned column, const char* name) = 0;
    virtual void SetReadColumnOptionDestinationId(unsigned key, unsigned column, unsigned id) = 0;
    virtual void ClearReadColumnOptions() = 0;

    // --- 62-67: the provider as a whole ---
    // Forgets worksheets, cells, options and the error, and puts the provider's own settings back.
    // Kept are the texts of SetMissingText and SetAlphaMissingNumeric (the latter switched off),
    // the helper, and what all providers share.
    virtual void ClearWorksheets() = 0;
    // Characters, of which the low 16 bits count: 0xFFFFFFFF, the default, is 65,535; 0 is no
    // limit.
    virtual void SetMaxVariableNameLength(unsigned length) = 0;
    // The provider takes the helper over and deletes it.
    virtual void SetDateTimeVariableFormatHelper(IDateTimeVariableFormat* helper) = 0;
    // Accepted and ignored.
    virtual void SetInferFormatPolicy(int policy) = 0;
    // Not supported: -1.
    virtual long RereadFile() = 0;
    // A preview converts the first 101 values of a column.
    virtual void SetPreviewing(bool previewing) = 0;

    // --- 68-71: the file on disk; the last two are accepted and ignored ---
    // Empty when no file is unpacked.
    virtual std::string GetTempDirectoryPath() const = 0;
    // The largest stored row number plus one, 0 for a worksheet without cells.
    virtual unsigned GetWorksheetRowCount(unsigned key) const = 0;
    virtual void SetUnitTesting(bool testing) = 0;
    virtual void SetTestNoTempFile(bool noTempFile) = 0;
};

// What the readers of a workbook need of a provider, and the settings a host may ask for.
class DPXLSX_API IExcelDataProvider : public IDataProvider {
  public:
    using IDataProvider::AddWorksheet;

    // --- 72-79: the error slot of the host, and what a reader delivers ---
    virtual void SetError(long error) = 0;
    virtual long GetError() const = 0;
    // Files one cell under the current worksheet; dropped while none is selected.
    virtual void AddExternalDataRecord(const ExternalDataRecord& record) = 0;
    // Positions are 0-based. A position that names no worksheet does nothing.
    virtual void RemoveWorksheet(int position) = 0;
    virtual void SetWorksheetIndex(int position) = 0;
    virtual void AddWorksheet(const char* name) = 0;
    // 0 and null for indices out of range.
    virtual unsigned GetColumnCount(int worksheet) const = 0;
    virtual IColumn* GetColumn(int worksheet, int column) const = 0;

    // --- 80-89: settings read back; texts belong to the provider ---
    virtual const char* GetMissingTextFrom() const = 0;
    virtual const char* GetMissingTextTo() const = 0;
    virtual double GetMissingVxlValue() const = 0;
    virtual const char* GetAlphaMissingNumericFrom() const = 0;
    virtual double GetMissingNumericTo() const = 0;
    virtual double GetMissingNumericFrom() const = 0;
    virtual bool GetWriteOptionVariableNames() const = 0;
    virtual bool IsPreviewing() const = 0;
    virtual int GetPreviewNumberOfRows() const = 0;
    virtual int GetPreviewNumberOfColumns() const = 0;
};

}  // namespace dp
