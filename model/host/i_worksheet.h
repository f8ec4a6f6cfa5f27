#pragma once

#include <string>

#include "export.h"
#include "i_resource.h"

namespace dp {

class IAnalysis;
class IDesign;
class IFormulaManager;
class IResponseModels;
class IString;

// How the host lays a worksheet out on screen and paper. An import brings no layout of its own: a
// view answers the same for every worksheet. Texts belong to the view, which belongs to its
// worksheet, and are never null. Font styles and justification are codes of the host, to which the
// library gives no meaning.
class DPXLSX_API IWorksheetView {
  public:
    virtual ~IWorksheetView() = default;

    // --- All six true ---
    virtual bool GetAllColumns() const = 0;
    virtual bool GetHorizontalEntry() const = 0;
    virtual bool GetPrintGrid() const = 0;
    virtual bool GetPrintColumnNames() const = 0;
    virtual bool GetPrintColumnLabels() const = 0;
    virtual bool GetPrintRowLabels() const = 0;

    // --- Rows and columns of the worksheet, 1-based: all four 1 ---
    virtual int GetActiveRow() const = 0;
    virtual int GetActiveColumn() const = 0;
    virtual int GetLeftmostVisibleColumn() const = 0;
    virtual int GetTopVisibleRow() const = 0;

    // Always 8, in the host's unit of column widths.
    virtual double GetStandardColumnWidth() const = 0;
    // Always 0.
    virtual int GetDataFontStyle() const = 0;
    // Always 2.
    virtual int GetLabelFontStyle() const = 0;

    // --- Points: both 10 ---
    virtual int GetDataFontPointSize() const = 0;
    virtual int GetLabelFontPointSize() const = 0;

    // Always 0.
    virtual int GetPrintJustification() const = 0;

    // --- Both "Arial" ---
    virtual const IString* GetDataFontFaceName() const = 0;
    virtual const IString* GetLabelFontFaceName() const = 0;

    // Always "*", whatever SetMissingValueTextRepresentation says.
    virtual const IString* GetMissingValue() const = 0;
};

// One worksheet of a workbook: its key and title; the rest is the same for every import. What a
// getter returns by pointer or reference belongs to the worksheet and is valid while it lives.
class DPXLSX_API IWorksheet : public IResource {
  public:
    // The key by which FindWorksheet found it.
    virtual int GetPrimeKey() const = 0;
    // Changes this object only; the provider does not learn of it.
    virtual void SetPrimeKey(int key) = 0;
    // The worksheet's name in the workbook, UTF-8; SetReadOptionCleanWorksheetNames may have
    // changed it when the file was opened.
    virtual const std::string& GetTitle() const = 0;
    // Always false, also for a worksheet with hidden columns.
    virtual bool GetHiddenColumnsUsed() const = 0;
    // Always 0.
    virtual double GetVersion() const = 0;

    // --- Always empty: the properties of the document are not read ---
    virtual const std::string& GetCreator() const = 0;
    virtual const std::string& GetCreationDates() const = 0;
    virtual const std::string& GetComments() const = 0;

    // Always 1, a code of the host.
    virtual int GetOSVersion() const = 0;
    // Never null.
    virtual const IWorksheetView* GetView() const = 0;
    // Always 0.
    virtual int GetDDELinkCount() const = 0;
    // Never null; the manager has no formulas.
    virtual const IFormulaManager* GetFormulaManager() const = 0;

    // --- Always null: an import has none of these ---
    virtual IDesign* GetDesign() const = 0;
    virtual IAnalysis* GetAnalysis() const = 0;
    virtual IResponseModels* GetResponseModels() const = 0;

    // --- The same objects as above, not const ---
    virtual IWorksheetView* GetView() = 0;
    virtual IFormulaManager* GetFormulaManager() = 0;
};

}  // namespace dp
