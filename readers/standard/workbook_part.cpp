#include "dpxlsx/readers/standard/workbook_part.h"

#include "dpxlsx/readers/standard/cell_values.h"
#include "dpxlsx/readers/standard/element_walker.h"
#include "dpxlsx/readers/standard/string_items.h"

namespace dp::standard {

namespace {

Sheet readSheet(ElementWalker& walker) {
    Sheet sheet{walker.attribute("name").value_or(""),
                walker.attribute("id", Vocabulary::Relationships).value_or("")};
    if (sheet.name.empty() || sheet.relationshipId.empty()) throw CmXmlException(kXmlError);
    decodeEscapes(sheet.name);
    return sheet;
}

}  // namespace

WorkbookPart readWorkbookPart(const std::string& path) {
    ElementWalker walker(path);
    if (!walker.is("workbook")) throw CmXmlException(kXmlError);
    WorkbookPart workbook;
    bool listed = false;
    walker.children([&](std::string_view name) {
        if (name == "workbookPr") {
            workbook.date1904 = parseBoolean(walker.attribute("date1904").value_or("")) == true;
        } else if (name == "sheets") {
            listed = true;
            walker.children([&](std::string_view child) {
                if (child == "sheet") workbook.sheets.push_back(readSheet(walker));
            });
        }
    });
    walker.finish();
    if (!listed) throw CmXmlException(kXmlError);
    return workbook;
}

}  // namespace dp::standard
