#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/model/collections.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_data_provider.h"
#include "dpxlsx/model/host/i_finders.h"
#include "dpxlsx/model/host/i_variable_format.h"
#include "dpxlsx/model/host/i_worksheet.h"
#include "dpxlsx/store/blank_rows.h"
#include "dpxlsx/store/external_data_record.h"
#include "dpxlsx/store/read_options.h"
#include "dpxlsx/store/reading_rules.h"
#include "dpxlsx/store/worksheet_cells.h"

namespace dp {

class CellFormats;
struct ConversionSettings;
struct LoadSettings;
struct RowLayout;

// The kind in which a column is requested; Automatic is the kind of its first data cell.
enum class ColumnType : int { Numeric = 0, Text = 1, Automatic = 2 };

// The provider without the file: settings, read options, the worksheets that a reader announced and
// their cells, and the columns made of them on demand. Providers that open files derive from it.
//
// The order of the virtual operations and of the members is part of the binary contract; the
// banners give the slots. Their definitions are in
//
//   excel_data_provider_base.cpp  life, and what remains when worksheets are cleared
//   unsupported.cpp               the write side, and the queries that never find anything
//   settings.cpp                  the settings of one provider, and those that are ignored
//   process_settings.cpp          the settings of the process
//   read_options.cpp              read options
//   worksheet_registry.cpp        the worksheets, and the cells that a reader delivers
//   rows.cpp                      row layout
//   columns.cpp                   columns on demand, and conversion
//
// One provider is used by one thread at a time; the static settings are shared by all providers of
// the process, without locks: no thread may change one while others work.
class DPXLSX_API ExcelDataProviderBase : public IExcelDataProvider,
                                         public IWorksheetFinder,
                                         public IVariableFinder {
  public:
    ExcelDataProviderBase();
    ExcelDataProviderBase(const ExcelDataProviderBase&) = delete;
    ExcelDataProviderBase& operator=(const ExcelDataProviderBase&) = delete;

    // --- 0-3: life ---
    ~ExcelDataProviderBase() override;
    unsigned AddRef() override;
    void Release() override;

    // --- 7-27: write side, not supported ---
    long AddWorksheet(IWorksheet* worksheet) override;
    long AddDesign(IDesign* design) override;
    long AddTaguchiDesign(ITaguchiDesign* design) override;
    long AddTaguchiAnalysis(ITaguchiAnalysis* analysis) override;
    long AddTaguchiPrediction(ITaguchiPrediction* prediction) override;
    long AddAnalysis(IAnalysis* analysis) override;
    long AddResponseModels(IResponseModels* models) override;
    long AddVariabilityDataCollection(IVariabilityDataCollection* collection) override;
    long AddMultipleResponseOptimization(IMultipleResponseOptimization* optimization) override;
    long AddMixtureResponseModelCollection(IMixtureResponseModelCollection* models) override;
    long AddColumn(INumericColumn* column) override;
    long AddColumn(ITextColumn* column) override;
    long AddConstant(INumericConstant* constant) override;
    long AddConstant(ITextConstant* constant) override;
    long AddMatrix(IMatrix* matrix) override;
    long AddModel(IModel* model) override;
    long AddFactorialPlot(IFactorialPlot* plot) override;
    long AddMixturePlot(IMixturePlot* plot) override;
    long AddCustomDesign(ICustomDesign* design) override;
    long AddFormulaNode(IFormulaNode* node) override;
    long AddDDELink(IDDELink* link) override;

    // --- 28-30: what the provider offers ---
    IWorksheetFinder* GetWorksheetFinder() override;
    IVariableFinder* GetVariableFinder() override;
    IDOEReader* GetDOEReader() override;

    // --- 31-43: settings ---
    void SetMissingValue(double value) override;
    void SetMissingValueTextRepresentation(const char* text) override;
    void SetNumericRange(double minimum, double maximum) override;
    void SetMaximumTextLength(int length) override;
    void SetInputDecimal(char symbol) override;
    void SetOutputDecimal(char symbol) override;
    void SetOutputGroupingSymbol(char symbol) override;
    void SetBooleanTrueValue(const char* text) override;
    void SetBooleanFalseValue(const char* text) override;
    void SetWriteOptionVariableNames(bool write) override;
    void SetMissingText(const char* from, const char* to) override;
    void SetMissingNumeric(double from, double to) override;
    void SetAlphaMissingNumeric(const char* from, double to) override;

    // --- 44-46: accepted and ignored ---
    void SetFieldDelimiter(char symbol) override;
    void SetTextDelimiter(char symbol) override;
    void SetDecimalSeparator(char symbol) override;

    // --- 47-52: read options of the whole file ---
    void SetReadOptionIgnoreBlankRows(bool ignore) override;
    void SetReadOptionPadColumnsWithMissingValues(bool pad) override;
    void SetReadOptionCleanTextValues(bool clean) override;
    void SetReadOptionFoldTextValues(bool fold) override;
    void SetReadOptionCleanWorksheetNames(bool clean) override;
    void SetReadOptionConvertDateTimeToText(bool convert) override;

    // --- 53-56: read options per worksheet ---
    void SetReadOptionDataRowPositions(unsigned key, EVariableNameRowSetting setting,
                                       unsigned nameRow, unsigned firstRow) override;
    void SetReadOptionDefaultUseVariableNameRow(EVariableNameRowSetting setting) override;
    void SetReadOptionDataRowCount(unsigned key, unsigned count) override;
    void SetReadOptionExclude(unsigned key, bool exclude) override;

    // --- 57-61: read options per column ---
    void SetReadColumnOptionExclude(unsigned key, unsigned column, bool exclude) override;
    void SetReadColumnOptionColumnType(unsigned key, unsigned column,
                                       IVariable::BasicDataType type) override;
    void SetReadColumnOptionName(unsigned key, unsigned column, const char* name) override;
    void SetReadColumnOptionDestinationId(unsigned key, unsigned column, unsigned id) override;
    void ClearReadColumnOptions() override;

    // --- 62-67: the provider as a whole ---
    void ClearWorksheets() override;
    void SetMaxVariableNameLength(unsigned length) override;
    void SetDateTimeVariableFormatHelper(IDateTimeVariableFormat* helper) override;
    void SetInferFormatPolicy(int policy) override;
    long RereadFile() override;
    void SetPreviewing(bool previewing) override;

    // --- 68-71: the file on disk ---
    std::string GetTempDirectoryPath() const override;
    unsigned GetWorksheetRowCount(unsigned key) const override;
    void SetUnitTesting(bool testing) override;
    void SetTestNoTempFile(bool noTempFile) override;

    // --- 72-79: the error slot of the host, and what a reader delivers ---
    void SetError(long error) override;
    long GetError() const override;
    void AddExternalDataRecord(const ExternalDataRecord& record) override;
    void RemoveWorksheet(int position) override;
    void SetWorksheetIndex(int position) override;
    void AddWorksheet(const char* name) override;
    unsigned GetColumnCount(int worksheet) const override;
    IColumn* GetColumn(int worksheet, int column) const override;

    // --- 80-89: settings read back ---
    const char* GetMissingTextFrom() const override;
    const char* GetMissingTextTo() const override;
    double GetMissingVxlValue() const override;
    const char* GetAlphaMissingNumericFrom() const override;
    double GetMissingNumericTo() const override;
    double GetMissingNumericFrom() const override;
    bool GetWriteOptionVariableNames() const override;
    bool IsPreviewing() const override;
    int GetPreviewNumberOfRows() const override;
    int GetPreviewNumberOfColumns() const override;

    // --- 90-91: IWorksheetFinder ---
    IReadOnlyCollection<int>* GetWorksheetPrimeKeys() const override;
    bool FindWorksheet(int key, IWorksheet** worksheet) const override;

    // --- 92-102: IVariableFinder ---
    IReadOnlyCollection<int>* GetColumnPrimeKeys(int worksheetKey) const override;
    IReadOnlyCollection<int>* GetConstantPrimeKeys(int worksheetKey) const override;
    IReadOnlyCollection<int>* GetMatrixPrimeKeys(int worksheetKey) const override;
    IReadOnlyCollection<int>* GetModelPrimeKeys(IModel::ModelSubtype subtype,
                                                int worksheetKey) const override;
    bool FindColumn(int key, IColumn** column, bool ignoreExclusion) const override;
    bool FindColumn(int key, IColumn** column, IVariable::StorageType storage,
                    IVariableFormat::FormatType* formatType, bool ignoreExclusion) const override;
    bool FindConstant(int key, IConstant** constant) const override;
    bool FindMatrix(int key, IMatrix** matrix) const override;
    bool FindModel(int key, IModel** model) const override;
    bool FindRegisteredSharedVariableBody(int key, IVariable** body) const override;
    void RegisterSharedVariableBody(int key, IVariable* body) override;

    // --- 103-108: the date-time helper, columns and conversion ---
    // The host's helper, owned by the provider; null when none was set.
    virtual IDateTimeVariableFormat* GetDateTimeVariableFormatHelper() const;
    // Loads the column `key` in the kind `requested` unless a column option asks for another;
    // `*formatType` becomes the kind of its first data cell or that of the option, which is Numeric
    // for date-times too. Both out-pointers may be null. False, and a null `*column`, for an
    // unknown key and for an excluded column unless `ignoreExclusion`.
    virtual bool FindColumn(int key, IColumn** column, ColumnType requested,
                            IVariableFormat::FormatType* formatType, bool ignoreExclusion) const;
    // The cell as text, cut to GetMaximumTextLength() bytes when `truncate`.
    virtual std::string ConvertCellToString(const ExternalDataRecordCell& cell,
                                            bool truncate) const;
    // A number or date-time cell as its style shows it. Loading converts by the same rules without
    // these two calls.
    virtual std::string ConvertNumericCellToString(const ExternalDataRecordCell& cell) const;
    // A new format for the cell's style, never null, owned by the caller. Loading asks once for all
    // cells of one `formatIndex`.
    virtual IVariableFormat* CreateVextralNumericFormat(
        const ExternalDataRecordCell& cell) const = 0;
    // Whether the cell's style shows dates or times.
    virtual bool IsDateTimeFormatType(const ExternalDataRecordCell& cell) const = 0;

    // --- Cell conversion ---
    // The cell as number; the missing value when it has none that the settings allow. `converted`
    // tells of content that did not convert. `dateTimeFormat` is the pattern by which texts are
    // read as date-times, null when not known.
    double ConvertCellToReal(const ExternalDataRecordCell& cell, bool asDateTime,
                             const IString* dateTimeFormat, bool& converted) const;

    // --- Row layout; a key that names no worksheet finds no rows, but options are made for it ---
    // Determines the worksheet's name row and first data row, unless it is excluded.
    void CalculateRowOffsets(unsigned key) const;
    // Decides from the first row whether the worksheet has a row of variable names, when its
    // setting is VNR_INFER.
    void InferVariableNameRow(unsigned key) const;
    // Determines and keeps the worksheet's last row, when blank rows are ignored or columns padded;
    // an earlier result is not changed.
    void FindLastRow(unsigned key) const;
    // Determines and keeps the worksheet's blank rows, when they are ignored; an earlier result is
    // not changed.
    void FindBlankRows(unsigned key) const;
    // Rows that a column of the worksheet gets when it is loaded.
    unsigned GetLoadColumnRowCount(unsigned key, const CellColumn& column) const;
    // Value slots between `expectedRow` and `cell`. Those of rows without a cell receive the host's
    // replacement of missing numbers where one is set.
    unsigned HandleBlankRows(INumericColumn* column, unsigned key, unsigned expectedRow,
                             unsigned rowCount, CellColumn::const_iterator cell) const;

    // --- Loading; the columns are new, with a reference count of 0 ---
    // `columnIndex` and `position` are 0-based: the column's index in the sheet and its position at
    // the host. `formatType` says how the first data cell is shown and is only read; null stands
    // for Numeric.
    INumericColumn* LoadNumericColumn(unsigned worksheetKey, const CellColumn& cells,
                                      unsigned columnIndex, unsigned position,
                                      const std::string& name, int key,
                                      IVariableFormat::FormatType* formatType) const;
    ITextColumn* LoadTextColumn(unsigned worksheetKey, const CellColumn& cells,
                                unsigned columnIndex, unsigned position, const std::string& name,
                                int key) const;

    // Sets the rules for the next open or listing and those after it.
    void setReadingRules(ReadingRules rules) { _readingRules = rules; }

    // --- Worksheet registry; positions are 0-based ---
    // 0 for a position that names no worksheet.
    int GetWorksheetPrimeKey(unsigned position) const;
    // Number of worksheets with a smaller key: the position of `key` when it is one.
    unsigned GetWorksheetPosition(unsigned key) const;
    // Empty for a position that names no worksheet.
    std::string GetWorksheetName(int position) const;
    // The number of worksheets that were written: always 0, nothing can be written. Those that were
    // read are the keys of GetWorksheetPrimeKeys().
    int GetWorksheetCount() const;
    // Always empty.
    std::string GetFileName() const;

    // --- Settings of the process, as the operations of slots 31 to 39 set them; texts are valid
    // until they are set again ---
    static double GetMissingValue();
    static const char* GetMissingValueTextRepresentation();
    static const char* GetBooleanTrueValue();
    static const char* GetBooleanFalseValue();
    static double GetNumericMinimumValue();
    static double GetNumericMaximumValue();
    // 2147000000; the library neither changes nor uses it.
    static double GetNumericMaximumInt();
    static int GetMaximumTextLength();
    static char GetInputDecimal();
    static char GetOutputDecimal();
    static char GetOutputGroupingSymbol();

    static double _missingValue;
    static double _minNumericValue;
    static double _maxNumericValue;
    static double _maxNumericInt;
    static std::int32_t _maxTextLength;  // bytes
    static char _inputDecimal;
    static char _outputDecimal;
    static char _outputGroupingSymbol;
    static std::string _missingValueText;
    static std::string _trueValue;
    static std::string _falseValue;

  protected:
    // Resets everything that ClearWorksheets promises to forget.
    void ResetInternalData();

    // Mutable members keep results that const queries compute when first asked: hosts query through
    // const interfaces, and the results must stay the same until the worksheets are cleared.
    std::uint32_t _refCount = 0;
    std::string _fileName;
    bool _previewing = false;
    int _worksheetIndex = -1;
    std::vector<std::vector<IColumn*>> _worksheetColumns;  // written ones: the library adds none
    std::vector<std::string> _worksheetNames;
    std::vector<WorksheetCells> _cells;  // what was read, by the position of the worksheet
    mutable ReadOnlyCollection<int> _columnKeys;
    ReadOnlyCollection<int> _allWorksheetKeys;
    mutable ReadOnlyCollection<int> _worksheetKeys;
    std::string _missingTextFrom;
    std::string _missingTextTo;
    bool _writeVariableNames = true;
    double _missingNumericFrom = 0.0;
    double _missingNumericTo = 0.0;
    bool _alphaMissingNumericSet = false;
    std::string _alphaMissingNumericFrom;
    mutable std::map<unsigned, SheetReadOptions> _sheetReadOptions;
    bool _ignoreBlankRows = false;
    mutable std::map<unsigned, BlankRows> _blankRows;
    bool _padColumnsWithMissing = false;
    mutable std::map<unsigned, unsigned> _lastRows;
    bool _cleanTextValues = false;
    bool _cleanWorksheetNames = false;
    bool _convertDateTimeToText = false;
    std::map<unsigned, ColumnOptions> _columnReadOptions;
    std::uint32_t _maxVariableNameLength = kNotSet;
    long _error = 0;
    EVariableNameRowSetting _defaultVariableNameRowSetting{kNotSet};
    // The next two are declared here because they fit into the padding between the setting and the
    // helper, so no field that hosts know is moved.
    ReadingRules _readingRules = ReadingRules::Default;  // for the next open or listing
    ReadingRules _rulesOfCells = ReadingRules::Default;  // those of the last open
    std::shared_ptr<IDateTimeVariableFormat> _dateTimeHelper;

  private:
    // Whether the stored cells were read by the standard.
    bool isByStandard() const { return _rulesOfCells == ReadingRules::Standard; }
    ColumnReadOptions& columnOptions(unsigned key, unsigned column);
    const ColumnOptions& columnOptionsOf(unsigned key) const;
    // The options of a worksheet, made on demand: with the host's default setting, or plain.
    SheetReadOptions& optionsWithDefaultSetting(unsigned key) const;
    SheetReadOptions& plainOptions(unsigned key) const;
    bool isExcluded(unsigned key) const;
    bool worksheetExists(unsigned key) const;
    const WorksheetCells& cellsOf(unsigned key) const;
    RowLayout rowLayout(unsigned key) const;
    ConversionSettings conversionSettings() const;
    LoadSettings loadSettings(unsigned worksheetKey, const CellColumn& cells,
                              const CellFormats& formats) const;
    std::string variableNameInSheet(unsigned worksheetKey, const CellColumn& cells) const;
    IVariableFormat::FormatType firstDataType(unsigned worksheetKey, const CellColumn& cells,
                                              ColumnType requested) const;
    IReadOnlyCollection<int>* noKeys() const;
};

}  // namespace dp
