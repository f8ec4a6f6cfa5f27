#include "dpxlsx/readers/standard/worksheet_part.h"

#include <utility>

#include "dpxlsx/readers/standard/cell_values.h"
#include "dpxlsx/readers/standard/element_walker.h"
#include "dpxlsx/readers/standard/string_items.h"

namespace dp::standard {

namespace {

class WorksheetReading {
  public:
    WorksheetReading(const std::string& path, CellReferences& references, const CellSink& sink)
        : walker_(path), references_(references), sink_(sink) {}

    void run() {
        walker_.children([this](std::string_view name) {
            if (name != "sheetData") return;
            walker_.children([this](std::string_view child) {
                if (child == "row") readRow();
            });
        });
        walker_.finish();
    }

  private:
    void readRow() {
        order_.beginRow(parseIndex(walker_.attribute("r").value_or("")));
        walker_.children([this](std::string_view name) {
            if (name == "c") readCell();
        });
    }

    void readCell() {
        const CellPosition position = order_.cell(readReference());
        CellMarkup markup{.type = walker_.attribute("t").value_or("n"),
                          .style = parseIndex(walker_.attribute("s").value_or("0")).value_or(-1),
                          .value = std::nullopt,
                          .inlineText = std::nullopt};
        walker_.children([&](std::string_view name) {
            if (name == "v")
                markup.value = walker_.text();
            else if (name == "is")
                markup.inlineText = readStringItem(walker_);
        });
        if (auto content = contentOf(markup, references_)) sink_(position, *std::move(content));
    }

    std::optional<CellPosition> readReference() {
        const std::optional<std::string> reference = walker_.attribute("r");
        if (!reference) return std::nullopt;
        const std::optional<CellPosition> position = parseReference(*reference);
        if (!position) throw CmXmlException(kXmlError);
        return position;
    }

    ElementWalker walker_;
    CellReferences& references_;
    const CellSink& sink_;
    CellOrder order_;
};

}  // namespace

void readWorksheetPart(const std::string& path, CellReferences& references, const CellSink& sink) {
    WorksheetReading(path, references, sink).run();
}

}  // namespace dp::standard
