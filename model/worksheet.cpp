#include "dpxlsx/model/worksheet.h"

#include "dpxlsx/model/reference_count.h"

namespace dp {

WorksheetView::WorksheetView() = default;
WorksheetView::~WorksheetView() = default;

bool WorksheetView::GetAllColumns() const { return allColumns; }
bool WorksheetView::GetHorizontalEntry() const { return horizontalEntry; }
bool WorksheetView::GetPrintGrid() const { return printGrid; }
bool WorksheetView::GetPrintColumnNames() const { return printColumnNames; }
bool WorksheetView::GetPrintColumnLabels() const { return printColumnLabels; }
bool WorksheetView::GetPrintRowLabels() const { return printRowLabels; }
int WorksheetView::GetActiveRow() const { return activeRow; }
int WorksheetView::GetActiveColumn() const { return activeColumn; }
int WorksheetView::GetLeftmostVisibleColumn() const { return leftmostVisibleColumn; }
int WorksheetView::GetTopVisibleRow() const { return topVisibleRow; }
double WorksheetView::GetStandardColumnWidth() const { return standardColumnWidth; }
int WorksheetView::GetDataFontStyle() const { return dataFontStyle; }
int WorksheetView::GetLabelFontStyle() const { return labelFontStyle; }
int WorksheetView::GetDataFontPointSize() const { return dataFontPointSize; }
int WorksheetView::GetLabelFontPointSize() const { return labelFontPointSize; }
int WorksheetView::GetPrintJustification() const { return printJustification; }
const IString* WorksheetView::GetDataFontFaceName() const { return &dataFontFaceName; }
const IString* WorksheetView::GetLabelFontFaceName() const { return &labelFontFaceName; }
const IString* WorksheetView::GetMissingValue() const { return &missingValue; }

Worksheet::Worksheet() = default;
Worksheet::~Worksheet() = default;

unsigned Worksheet::AddRef() { return static_cast<unsigned>(++refCount); }
int Worksheet::GetPrimeKey() const { return primeKey; }
void Worksheet::SetPrimeKey(int key) { primeKey = key; }
const std::string& Worksheet::GetTitle() const { return title; }
bool Worksheet::GetHiddenColumnsUsed() const { return hiddenColumnsUsed; }
double Worksheet::GetVersion() const { return version; }
const std::string& Worksheet::GetCreator() const { return creator; }
const std::string& Worksheet::GetCreationDates() const { return creationDates; }
const std::string& Worksheet::GetComments() const { return comments; }
int Worksheet::GetOSVersion() const { return osVersion; }
const IWorksheetView* Worksheet::GetView() const { return &view; }
int Worksheet::GetDDELinkCount() const { return 0; }
const IFormulaManager* Worksheet::GetFormulaManager() const { return &formulaManager; }
IDesign* Worksheet::GetDesign() const { return nullptr; }
IAnalysis* Worksheet::GetAnalysis() const { return nullptr; }
IResponseModels* Worksheet::GetResponseModels() const { return nullptr; }
IWorksheetView* Worksheet::GetView() { return &view; }
IFormulaManager* Worksheet::GetFormulaManager() { return &formulaManager; }

void Worksheet::Release() {
    if (releaseReference(refCount)) delete this;
}

}  // namespace dp
