#pragma once

#include <string>

#include "model/host/export.h"
#include "model/host/i_resource.h"

namespace dp {

class IAnalysis;
class IDesign;
class IFormulaManager;
class IResponseModels;
class IString;

// How the host lays a worksheet out on screen and paper. Texts belong to the view.
class DPXLSX_API IWorksheetView {
  public:
    virtual ~IWorksheetView() = default;

    virtual bool GetAllColumns() const = 0;
    virtual bool GetHorizontalEntry() const = 0;
    virtual bool GetPrintGrid() const = 0;
    virtual bool GetPrintColumnNames() const = 0;
    virtual bool GetPrintColumnLabels() const = 0;
    virtual bool GetPrintRowLabels() const = 0;
    // 1-based, like the next three.
    virtual int GetActiveRow() const = 0;
    virtual int GetActiveColumn() const = 0;
    virtual int GetLeftmostVisibleColumn() const = 0;
    virtual int GetTopVisibleRow() const = 0;
    // Characters.
    virtual double GetStandardColumnWidth() const = 0;
    virtual int GetDataFontStyle() const = 0;
    virtual int GetLabelFontStyle() const = 0;
    virtual int GetDataFontPointSize() const = 0;
    virtual int GetLabelFontPointSize() const = 0;
    virtual int GetPrintJustification() const = 0;
    virtual const IString* GetDataFontFaceName() const = 0;
    virtual const IString* GetLabelFontFaceName() const = 0;
    virtual const IString* GetMissingValue() const = 0;
};

// One worksheet of a workbook. What a getter returns by pointer or reference belongs to the
// worksheet and is valid while it lives.
class DPXLSX_API IWorksheet : public IResource {
  public:
    virtual int GetPrimeKey() const = 0;
    virtual void SetPrimeKey(int key) = 0;
    virtual const std::string& GetTitle() const = 0;
    virtual bool GetHiddenColumnsUsed() const = 0;
    virtual double GetVersion() const = 0;
    virtual const std::string& GetCreator() const = 0;
    virtual const std::string& GetCreationDates() const = 0;
    virtual const std::string& GetComments() const = 0;
    virtual int GetOSVersion() const = 0;
    virtual const IWorksheetView* GetView() const = 0;
    virtual int GetDDELinkCount() const = 0;
    virtual const IFormulaManager* GetFormulaManager() const = 0;
    // An import carries none of these three: null.
    virtual IDesign* GetDesign() const = 0;
    virtual IAnalysis* GetAnalysis() const = 0;
    virtual IResponseModels* GetResponseModels() const = 0;
    virtual IWorksheetView* GetView() = 0;
    virtual IFormulaManager* GetFormulaManager() = 0;
};

}  // namespace dp
