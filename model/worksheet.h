#pragma once

#include <string>

#include "dpxlsx/model/formula.h"
#include "dpxlsx/model/host/i_worksheet.h"
#include "dpxlsx/model/string.h"

// The worksheet objects handed to the host. A getter returns the field of its name. The provider
// fills the key and the title of a worksheet; an import leaves all other fields at their defaults.
// Field and slot order are part of the binary contract.
namespace dp {

class DPXLSX_API WorksheetView : public IWorksheetView {
  public:
    WorksheetView();
    ~WorksheetView() override;

    bool GetAllColumns() const override;
    bool GetHorizontalEntry() const override;
    bool GetPrintGrid() const override;
    bool GetPrintColumnNames() const override;
    bool GetPrintColumnLabels() const override;
    bool GetPrintRowLabels() const override;
    int GetActiveRow() const override;
    int GetActiveColumn() const override;
    int GetLeftmostVisibleColumn() const override;
    int GetTopVisibleRow() const override;
    double GetStandardColumnWidth() const override;
    int GetDataFontStyle() const override;
    int GetLabelFontStyle() const override;
    int GetDataFontPointSize() const override;
    int GetLabelFontPointSize() const override;
    int GetPrintJustification() const override;
    const IString* GetDataFontFaceName() const override;
    const IString* GetLabelFontFaceName() const override;
    const IString* GetMissingValue() const override;

    bool allColumns = true;
    bool horizontalEntry = true;
    bool printGrid = true;
    bool printColumnNames = true;
    bool printColumnLabels = true;
    bool printRowLabels = true;
    int activeRow = 1;
    int activeColumn = 1;
    int leftmostVisibleColumn = 1;
    int topVisibleRow = 1;
    double standardColumnWidth = 8.0;
    int dataFontStyle = 0;
    int labelFontStyle = 2;
    int dataFontPointSize = 10;
    int labelFontPointSize = 10;
    int printJustification = 0;
    String dataFontFaceName{"Arial"};
    String labelFontFaceName{"Arial"};
    String missingValue{"*"};
};

class DPXLSX_API Worksheet : public IWorksheet {
  public:
    Worksheet();
    Worksheet(const Worksheet&) = delete;
    Worksheet& operator=(const Worksheet&) = delete;
    ~Worksheet() override;

    unsigned AddRef() override;
    void Release() override;

    int GetPrimeKey() const override;
    void SetPrimeKey(int key) override;
    const std::string& GetTitle() const override;
    bool GetHiddenColumnsUsed() const override;
    double GetVersion() const override;
    const std::string& GetCreator() const override;
    const std::string& GetCreationDates() const override;
    const std::string& GetComments() const override;
    int GetOSVersion() const override;
    const IWorksheetView* GetView() const override;
    int GetDDELinkCount() const override;
    const IFormulaManager* GetFormulaManager() const override;
    IDesign* GetDesign() const override;
    IAnalysis* GetAnalysis() const override;
    IResponseModels* GetResponseModels() const override;
    IWorksheetView* GetView() override;
    IFormulaManager* GetFormulaManager() override;

    int primeKey = 0;
    std::string title;
    std::string creator;
    std::string creationDates;
    std::string comments;
    bool hiddenColumnsUsed = false;
    double version = 0.0;
    int osVersion = 1;
    WorksheetView view;
    FormulaManager formulaManager;
    int refCount = 0;
};

}  // namespace dp
