#pragma once

#include <string>
#include <vector>

#include "export.h"
#include "i_resource.h"
#include "i_variable.h"

// The provider as the host sees it. The order of the operations is the binary contract: hosts call
// through the table of virtual functions, so nothing here is ever moved, inserted or removed.
//
// Result codes: 0 success, -1 failure, -50 not supported; for opening also -17 (no such file, or
// not a regular one), -18 (no private directory, or no room for the file there), -22 (the name does
// not end in ".xlsx", or the file is no ZIP package) and -25 (not a workbook). Operations that need
// memory throw std::bad_alloc when there is none; CloseFile throws nothing.
//
// A key is a worksheet's prime key; row and column numbers of the options are the sheet's own,
// 1-based. Options for a key or column that does not exist are kept until it does. Texts are UTF-8
// and copied; a null text counts as the empty text. Settings and options hold for columns that are
// loaded from then on, unless an operation says otherwise.
//
// A provider, with all that it hands out, is used by one thread at a time. Different providers may
// work in different threads at once while no thread changes a setting of the process.
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
    VNR_NONE = 0,   // there is none; values without a name here mean this too
    VNR_GIVEN = 1,  // a row that the host gives, the first one by default
    // The first row when it holds a text and no number or date-time, else none. Booleans of .xlsx
    // files are numbers.
    VNR_INFER = 2
};

class DPXLSX_API IDataProvider : public IResource {
  public:
    // OpenFile answers -1 to Write.
    enum class FileAccess : int { Read = 0, Write = 1 };

    // --- 4-6: opening, listing and closing a file ---
    // The worksheet names of a file in workbook order, without reading its cells; those without a
    // cell are named too. `names` is replaced; after a failure its content means nothing. Throws
    // the file system's errors. Not to be called while a file is open, whose unpacked parts go.
    virtual long GetWorksheets(const char* fileName, std::vector<std::string>& names) = 0;
    // Reads a whole workbook into the provider, behind the worksheets that it has already; -1 for
    // other access than Read. Errors in its XML leave as CmXmlException (readers/xml/xml_reader.h),
    // others, those of the file system for example, as std::exception. After any failure the
    // provider is usable, what was read until then stays, and CloseFile removes what is left on
    // disk.
    virtual long OpenFile(const char* fileName, FileAccess access) = 0;
    // Removes what opening left on disk and forgets how the file's cells are shown; cells and
    // settings stay. Always 0, also without an open file.
    virtual long CloseFile() = 0;

    // --- 7-27: write side, not supported: -50; the argument is not looked at ---
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

    // --- 28-30: what the provider offers; owned by the provider and valid while it lives ---
    // The provider's worksheets; never null.
    virtual IWorksheetFinder* GetWorksheetFinder() = 0;
    // The provider's columns; never null.
    virtual IVariableFinder* GetVariableFinder() = 0;
    // Null: an import has no designs.
    virtual IDOEReader* GetDOEReader() = 0;

    // --- 31-43: settings; the first nine are shared by all providers of the process ---
    // The number that marks a missing value in every column, 1.23456e30 by default. Not NaN:
    // values are compared with it by ==.
    virtual void SetMissingValue(double value) = 0;
    // What a text column shows for a cell that holds the missing value, "*" by default. Rows
    // without a cell are empty texts.
    virtual void SetMissingValueTextRepresentation(const char* text) = 0;
    // Numbers outside [minimum, maximum] become missing; INumericColumn::GetConvertedMissingCount
    // counts them. By default -1.001e18 and 1.001e18.
    virtual void SetNumericRange(double minimum, double maximum) = 0;
    // Bytes, 80 by default: longer texts, and names in the sheet, are cut, possibly inside a
    // character. Negative is no limit; 0 leaves empty texts.
    virtual void SetMaximumTextLength(int length) = 0;
    // The decimal symbol of numbers that are written as texts, and of all that formats render, also
    // those of columns loaded before; '.' by default.
    virtual void SetInputDecimal(char symbol) = 0;
    // Kept for the host, like the next one, and read by nothing here; '.' by default.
    virtual void SetOutputDecimal(char symbol) = 0;
    // ',' by default.
    virtual void SetOutputGroupingSymbol(char symbol) = 0;
    // What a text column shows for a Boolean cell, "TRUE" or "FALSE" by default. Booleans of .xlsx
    // files are not concerned: they arrive as the numbers 1 and 0.
    virtual void SetBooleanTrueValue(const char* text) = 0;
    // The same for false.
    virtual void SetBooleanFalseValue(const char* text) = 0;
    // Kept for the host, true by default.
    virtual void SetWriteOptionVariableNames(bool write) = 0;
    // In text columns, texts equal to `from` become `to`; both are empty by default. An empty
    // `from` stands for texts of spaces too, and for rows without a cell above the column's last
    // cell, which stay counted as missing.
    virtual void SetMissingText(const char* from, const char* to) = 0;
    // In numeric columns, numbers equal to `from` become `to`; both are 1.23456e30 by default. When
    // `from` is the missing value, so do cells without a number, and rows without a cell above the
    // column's last cell, which stay counted as missing. Rows below that cell stay missing.
    virtual void SetMissingNumeric(double from, double to) = 0;
    // In numeric columns, cells with exactly the text `from` become `to`, in place of what
    // SetMissingNumeric asks for; an empty `from`, the default, switches this off. `to` replaces
    // that of SetMissingNumeric in either case.
    virtual void SetAlphaMissingNumeric(const char* from, double to) = 0;

    // --- 44-46: accepted and ignored ---
    virtual void SetFieldDelimiter(char symbol) = 0;
    virtual void SetTextDelimiter(char symbol) = 0;
    virtual void SetDecimalSeparator(char symbol) = 0;

    // --- 47-52: read options of the whole file, all false by default ---
    // Leaves out the rows in which no column of the worksheet has a cell. They are looked for at
    // once in the worksheets that are there, else by GetWorksheetPrimeKeys, and kept until false is
    // set: columns that are not to count are excluded before.
    virtual void SetReadOptionIgnoreBlankRows(bool ignore) = 0;
    // Columns with a data cell or a name in the sheet go down to the worksheet's last row, which is
    // found when blank rows are, instead of their own last cell. A text column without a data cell
    // still has no rows.
    virtual void SetReadOptionPadColumnsWithMissingValues(bool pad) = 0;
    // In text columns and in names, white space at the ends and control characters go, and several
    // spaces become one.
    virtual void SetReadOptionCleanTextValues(bool clean) = 0;
    // Accepted and ignored.
    virtual void SetReadOptionFoldTextValues(bool fold) = 0;
    // Replaces ? * / : < > | " \ in the titles of worksheets that are opened from then on by "_"
    // and trims them; GetWorksheets still lists the names as they are.
    virtual void SetReadOptionCleanWorksheetNames(bool clean) = 0;
    // Columns that begin with a date-time arrive as texts. Date-times in a column that is loaded as
    // numeric all the same, or that begins with a number, become missing, and
    // INumericColumn::GetConvertedMissingCount counts them.
    virtual void SetReadOptionConvertDateTimeToText(bool convert) = 0;

    // --- 53-56: read options per worksheet ---
    // Where a worksheet has its names and its data, settled at once, or by GetWorksheetPrimeKeys
    // where VNR_INFER has no worksheet to look at yet. A row of 0 is not given: names are then in
    // row 1, and data from the row behind the names, or from row 1 without names. `nameRow` counts
    // with VNR_GIVEN only.
    virtual void SetReadOptionDataRowPositions(unsigned key, EVariableNameRowSetting setting,
                                               unsigned nameRow, unsigned firstRow) = 0;
    // The setting of worksheets that were given none, VNR_GIVEN by default. A worksheet takes it in
    // the first GetWorksheetPrimeKeys that lists it, but not if SetReadOptionDataRowPositions,
    // SetReadOptionDataRowCount, SetReadOptionExclude or FindColumn was called for it before.
    virtual void SetReadOptionDefaultUseVariableNameRow(EVariableNameRowSetting setting) = 0;
    // Reads at most `count` rows from the first data row, blank ones counted; 0 reads none. Before
    // the first GetWorksheetPrimeKeys this also fixes the worksheet's setting of the name row at
    // VNR_GIVEN, unless SetReadOptionDataRowPositions has given or gives another.
    virtual void SetReadOptionDataRowCount(unsigned key, unsigned count) = 0;
    // Leaves the worksheet out of GetWorksheetPrimeKeys from its next call on, or puts it back;
    // FindWorksheet and FindColumn find it all the same. Fixes the setting of the name row as
    // SetReadOptionDataRowCount does.
    virtual void SetReadOptionExclude(unsigned key, bool exclude) = 0;

    // --- 57-61: read options per column ---
    // FindColumn returns false unless told to ignore it; the column's key stays. Rows that only
    // excluded columns fill are blank for SetReadOptionIgnoreBlankRows. False by default.
    virtual void SetReadColumnOptionExclude(unsigned key, unsigned column, bool exclude) = 0;
    // The kind of the column whatever its cells and FindColumn say; NotSet by default. Cells that
    // do not fit become missing.
    virtual void SetReadColumnOptionColumnType(unsigned key, unsigned column,
                                               IVariable::BasicDataType type) = 0;
    // The name of the variable instead of the sheet's, cut to SetMaxVariableNameLength and with the
    // characters of names (see IColumn::GetName); the empty name, the default, leaves the sheet's.
    virtual void SetReadColumnOptionName(unsigned key, unsigned column, const char* name) = 0;
    // What GetPosition of the column returns, instead of its place in the sheet, which 0xFFFFFFFF,
    // the default, leaves.
    virtual void SetReadColumnOptionDestinationId(unsigned key, unsigned column, unsigned id) = 0;
    // Forgets the four options above for all columns of all worksheets.
    virtual void ClearReadColumnOptions() = 0;

    // --- 62-67: the provider as a whole ---
    // Forgets worksheets, cells, options and the error, and puts the provider's own settings back.
    // Kept are the texts of SetMissingText and SetAlphaMissingNumeric (the latter switched off),
    // the helper, what all providers share, and an open file on disk, which CloseFile removes.
    virtual void ClearWorksheets() = 0;
    // Longer names of variables are cut. Counts user-perceived characters, by the low 16 bits of
    // `length`: 0xFFFFFFFF, the default, is 65,535; 0 is no limit.
    virtual void SetMaxVariableNameLength(unsigned length) = 0;
    // The provider takes the helper over and deletes it when another one or null is set or the
    // provider goes; none by default. Without one every number in a date-time column is valid and
    // every text there becomes missing.
    virtual void SetDateTimeVariableFormatHelper(IDateTimeVariableFormat* helper) = 0;
    // Accepted and ignored.
    virtual void SetInferFormatPolicy(int policy) = 0;
    // Not supported: -1.
    virtual long RereadFile() = 0;
    // While previewing, FindColumn converts only the cells in the first 101 rows of a column. Cells
    // in later rows become empty texts, or 1.23456e30, which is missing only if it is the missing
    // value. OpenFile reads as much as ever, except for dates and styles of documents in XML
    // Spreadsheet 2003 (see GetPreviewNumberOfRows). False by default.
    virtual void SetPreviewing(bool previewing) = 0;

    // --- 68-71: the file on disk ---
    // The absolute path of the private directory of the open file; empty after CloseFile. After a
    // failure to open it may name a directory that is not there.
    virtual std::string GetTempDirectoryPath() const = 0;
    // The number of the last row with a cell, 1-based; 0 for an unknown key.
    virtual unsigned GetWorksheetRowCount(unsigned key) const = 0;
    // Accepted and ignored, like the next one.
    virtual void SetUnitTesting(bool testing) = 0;
    virtual void SetTestNoTempFile(bool noTempFile) = 0;
};

// What the readers of a workbook need of a provider, and the settings that a host may ask for.
class DPXLSX_API IExcelDataProvider : public IDataProvider {
  public:
    using IDataProvider::AddWorksheet;

    // --- 72-79: the error slot of the host, and what a reader delivers; positions are 0-based ---
    // Keeps a number for the host; the library sets none itself.
    virtual void SetError(long error) = 0;
    // The number that was kept last, 0 until then and after ClearWorksheets.
    virtual long GetError() const = 0;
    // Files a copy of the cell under the current worksheet, replacing one in its place; dropped
    // while none is selected.
    virtual void AddExternalDataRecord(const ExternalDataRecord& record) = 0;
    // Removes a worksheet with its cells; those behind it move one position forward and keep their
    // keys. A position that names no worksheet does nothing.
    virtual void RemoveWorksheet(int position) = 0;
    // Selects the worksheet that receives cells; with a position that names none, such as -1, they
    // are dropped.
    virtual void SetWorksheetIndex(int position) = 0;
    // Adds a worksheet without cells at the end, under the next key; it is not selected by that.
    virtual void AddWorksheet(const char* name) = 0;
    // The number of columns that were written to a worksheet: always 0, nothing can be written.
    virtual unsigned GetColumnCount(int worksheet) const = 0;
    // A written column: always null.
    virtual IColumn* GetColumn(int worksheet, int column) const = 0;

    // --- 80-89: settings read back; texts are the provider's, valid until they are set again ---
    // `from` of SetMissingText.
    virtual const char* GetMissingTextFrom() const = 0;
    // `to` of SetMissingText.
    virtual const char* GetMissingTextTo() const = 0;
    // The number of SetMissingValue.
    virtual double GetMissingVxlValue() const = 0;
    // `from` of SetAlphaMissingNumeric, also when ClearWorksheets has switched it off.
    virtual const char* GetAlphaMissingNumericFrom() const = 0;
    // `to` of SetMissingNumeric or SetAlphaMissingNumeric, whichever came last.
    virtual double GetMissingNumericTo() const = 0;
    // `from` of SetMissingNumeric.
    virtual double GetMissingNumericFrom() const = 0;
    // The value of SetWriteOptionVariableNames.
    virtual bool GetWriteOptionVariableNames() const = 0;
    // The value of SetPreviewing.
    virtual bool IsPreviewing() const = 0;
    // Always 100, like the next one. While previewing, the reader of XML Spreadsheet 2003 documents
    // delivers cells beyond the first 100 rows and columns of the sheet without their style, and
    // their dates as the missing value. The rows of loaded columns that a preview converts are
    // another matter, see SetPreviewing.
    virtual int GetPreviewNumberOfRows() const = 0;
    // Always 100.
    virtual int GetPreviewNumberOfColumns() const = 0;
};

}  // namespace dp
