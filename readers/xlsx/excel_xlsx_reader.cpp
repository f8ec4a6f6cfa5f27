#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"

#include <map>
#include <string_view>
#include <utility>

#include "dpxlsx/formats/style_classification.h"
#include "dpxlsx/readers/xlsx/opened_package.h"
#include "dpxlsx/readers/xml/silence.h"

// The workbook: which worksheets there are, and in which order their parts are read.
namespace dp {

ExcelXLSXReader::ExcelXLSXReader(const std::string& dir, bool sharedStringsPresent,
                                 std::string shortDate, double missing,
                                 IExcelDataProvider* receiver, IDateTimeVariableFormat* helper)
    : ExcelXmlReader(dir + "/xl/workbook.xml", std::move(shortDate), missing, receiver, helper),
      hasSharedStrings(sharedStringsPresent),
      xlDir(dir + "/xl/"),
      opened_(std::make_unique<OpenedPackage>()) {
    opened_->dir = dir;
}

ExcelXLSXReader::ExcelXLSXReader(const std::string& workbookPart, std::string shortDate,
                                 double missing, IExcelDataProvider* receiver,
                                 IDateTimeVariableFormat* helper)
    : ExcelXmlReader(workbookPart, std::move(shortDate), missing, receiver, helper),
      hasSharedStrings(false),
      opened_(std::make_unique<OpenedPackage>()) {}

ExcelXLSXReader::~ExcelXLSXReader() = default;

void ExcelXLSXReader::mReadExcelWorkbook() {
    const SilentLibxml2 silent;
    mReadExcel2007Styles();
    mReadSharedStrings();
    mReadWorkbookRelationships(xlDir, relationshipIds, relationshipTargets);
    opened_->relationships = RelationshipIndex(relationshipIds);
    readSheets();
}

void ExcelXLSXReader::readSheets() {
    if (!xmlReader.mGotoElement("sheets")) throw CmXmlException(kXmlError);
    std::vector<unsigned> emptySheets;
    emptySheets.reserve(100);
    while (xml::mReadForElements(xmlReader, {"sheet"}) != -1) {
        readSheet(emptySheets);
        if (!xmlReader.readNode()) break;
    }
    removeEmptyWorksheets(emptySheets);
}

void ExcelXLSXReader::readSheet(std::vector<unsigned>& emptySheets) {
    const std::string name = xmlReader.attributeText("name");
    const std::string id = xmlReader.attributeText("r:id");
    if (name.empty() || id.empty()) throw CmXmlException(kXmlError);
    std::string target;
    mSearchWorkbookRelationships(id, target);
    if (target.empty()) return;  // a chart sheet, say
    beginWorksheet(name);
    readWorksheet(target);
    if (worksheetEmpty) emptySheets.push_back(static_cast<unsigned>(worksheetIndex - 1));
}

void ExcelXLSXReader::mSearchWorkbookRelationships(const std::string& id, std::string& target) {
    const std::ptrdiff_t index = opened_->relationships.find(id);
    if (index >= 0) target = relationshipTargets[static_cast<std::size_t>(index)];
}

void ExcelXLSXReader::resolveNumberKinds() {
    std::map<std::string_view, int> firstById;  // ordered: hashes could be made to collide
    for (std::size_t i = 0; i < styles.size(); ++i)
        firstById.try_emplace(styles[i].styleId, static_cast<int>(i));
    firstById.erase("");  // a cell format without an id has no number format
    std::vector<NumberKind>& numberKinds = opened_->numberKinds;
    numberKinds.clear();
    numberKinds.reserve(cellXfNumFmtIds.size());
    for (const std::string& id : cellXfNumFmtIds) {
        NumberKind kind;
        if (const auto style = firstById.find(id); style != firstById.end()) {
            kind.formatIndex = style->second;
            if (isDateTimeType(ExcelXmlReader::GetExcelFormatType(kind.formatIndex)))
                kind.type = CELL_DATETIME;
        }
        numberKinds.push_back(kind);
    }
}

namespace excel_xlsx {

void GetWorksheets(const std::string& dir, std::vector<std::string>& names) {
    const SilentLibxml2 silent;
    XmlReader reader;
    reader.mInitialize(dir + "/xl/workbook.xml");
    if (!reader.mGotoElement("sheets")) throw CmXmlException(kXmlError);
    names.clear();
    std::vector<std::string> ids;
    std::vector<std::string> targets;
    mReadWorkbookRelationships(dir + "/xl/", ids, targets);
    const RelationshipIndex index(ids);
    while (xml::mReadForElements(reader, {"sheet"}) != -1) {
        std::string name = reader.attributeText("name");
        const std::string id = reader.attributeText("r:id");
        if (name.empty() || id.empty()) throw CmXmlException(kXmlError);
        if (index.find(id) >= 0) names.push_back(std::move(name));
        if (!reader.readNode()) break;
    }
}

}  // namespace excel_xlsx

}  // namespace dp
