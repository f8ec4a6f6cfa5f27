#pragma once

#include <string>

#include "model/formula.h"
#include "model/host/i_worksheet.h"
#include "model/string.h"

// The worksheet objects handed to the host. Field and slot order are part of the binary contract.
namespace dp {

class DPXLSX_API WorksheetView : public IWorksheetView {
  public:
    WorksheetView() = default;

    bool GetAllColumns() const override { return allColumns; }
    bool GetHorizontalEntry() const override { return horizontalEntry; }
    bool GetPrintGrid() const override { return printGrid; }
    bool GetPrintColumnNames() const override { return printColumnNames; }
    bool GetPrintColumnLabels() const override { return printColumnLabels; }
    bool GetPrintRowLabels() const override { return printRowLabels; }
    int GetActiveRow() const override { return activeRow; }
    int GetActiveColumn() const override { return activeColumn; }
    int GetLeftmostVisibleColumn() const override { return leftmostVisibleColumn; }
    int GetTopVisibleRow() const override { return topVisibleRow; }
    double GetStandardColumnWidth() const override { return standardColumnWidth; }
    int GetDataFontStyle() const override { return dataFontStyle; }
    int GetLabelFontStyle() const override { return labelFontStyle; }
    int GetDataFontPointSize() const override { return dataFontPointSize; }
    int GetLabelFontPointSize() const override { return labelFontPointSize; }
    int GetPrintJustification() const override { return printJustification; }
    const IString* GetDataFontFaceName() const override { return &dataFontFaceName; }
    const IString* GetLabelFontFaceName() const override { return &labelFontFaceName; }
    const IString* GetMissingValue() const override { return &missingValue; }

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
    Worksheet() = default;
    Worksheet(const Worksheet&) = delete;
    Worksheet& operator=(const Worksheet&) = delete;
    ~Worksheet() override;

    unsigned AddRef() override { return static_cast<unsigned>(++refCount); }
    void Release() override;

    int GetPrimeKey() const override { return primeKey; }
    void SetPrimeKey(int key) override { primeKey = key; }
    const std::string& GetTitle() const override { return title; }
    bool GetHiddenColumnsUsed() const override { return hiddenColumnsUsed; }
    double GetVersion() const override { return version; }
    const std::string& GetCreator() const override { return creator; }
    const std::string& GetCreationDates() const override { return creationDates; }
    const std::string& GetComments() const override { return comments; }
    int GetOSVersion() const override { return osVersion; }
    const IWorksheetView* GetView() const override { return &view; }
    int GetDDELinkCount() const override { return 0; }
    const IFormulaManager* GetFormulaManager() const override { return &formulaManager; }
    IDesign* GetDesign() const override { return nullptr; }
    IAnalysis* GetAnalysis() const override { return nullptr; }
    IResponseModels* GetResponseModels() const override { return nullptr; }
    IWorksheetView* GetView() override { return &view; }
    IFormulaManager* GetFormulaManager() override { return &formulaManager; }

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
