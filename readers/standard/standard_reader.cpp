#include "dpxlsx/readers/standard/standard_reader.h"

#include <map>
#include <string_view>
#include <utility>

#include "dpxlsx/readers/standard/content_types.h"
#include "dpxlsx/readers/standard/string_items.h"
#include "dpxlsx/readers/standard/workbook_part.h"
#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/readers/xml/silence.h"

namespace dp {

namespace {

using standard::Relationship;
using standard::WorkbookPackage;

struct NamedPart {
    std::string name;
    std::string part;
};

// The sheets that are worksheets, not chart sheets, say.
std::vector<NamedPart> worksheetsOf(const std::vector<standard::Sheet>& sheets,
                                    const std::vector<Relationship>& relationships) {
    std::map<std::string_view, const std::string*> partById;
    for (const Relationship& relationship : relationships)
        if (relationship.type == "worksheet")
            partById.try_emplace(relationship.id, &relationship.part);
    std::vector<NamedPart> worksheets;
    for (const standard::Sheet& sheet : sheets)
        if (const auto found = partById.find(sheet.relationshipId); found != partById.end())
            worksheets.push_back({sheet.name, *found->second});
    return worksheets;
}

}  // namespace

StandardReader::StandardReader(const std::string& dir, std::string shortDate, double missing,
                               IExcelDataProvider* receiver, IDateTimeVariableFormat* helper)
    : StandardReader(WorkbookPackage(dir), std::move(shortDate), missing, receiver, helper) {}

StandardReader::StandardReader(WorkbookPackage package, std::string shortDate, double missing,
                               IExcelDataProvider* receiver, IDateTimeVariableFormat* helper)
    : ExcelXLSXReader(package.parts.pathOf(package.workbookPart), std::move(shortDate), missing,
                      receiver, helper),
      package_(std::move(package)) {}

StandardReader::~StandardReader() = default;

void StandardReader::mReadExcelWorkbook() {
    const SilentLibxml2 silent;
    const auto& [parts, workbookPart] = package_;
    const standard::WorkbookPart workbook = standard::readWorkbookPart(parts.pathOf(workbookPart));
    const std::vector<Relationship> relationships = parts.relationshipsOf(workbookPart);
    references_.date1904 = workbook.date1904;
    readReferences(relationships);
    std::vector<unsigned> emptySheets;
    for (const auto& [name, part] : worksheetsOf(workbook.sheets, relationships)) {
        beginWorksheet(name);
        readWorksheet(parts.pathOf(part));
        if (worksheetEmpty) emptySheets.push_back(static_cast<unsigned>(worksheetIndex - 1));
    }
    removeEmptyWorksheets(emptySheets);
}

// A workbook may have no styles and no shared strings.
void StandardReader::readReferences(const std::vector<Relationship>& relationships) {
    const auto pathByType = [&](std::string_view type) {
        return package_.parts.pathByType(relationships, type, package_.workbookPart);
    };
    if (const std::string styleSheet = pathByType("styles"); !styleSheet.empty())
        references_.formats.read(styleSheet);
    if (const std::string strings = pathByType("sharedStrings"); !strings.empty()) {
        standard::readSharedStrings(strings, references_.strings);
        textBudget_.addPart(strings);
    }
}

void StandardReader::readWorksheet(const std::string& path) {
    repeatedParts_.visit(path);
    textBudget_.addPart(path);
    standard::readWorksheetPart(
        path, references_,
        [this](standard::CellPosition position, ExternalDataRecordCell&& content) {
            take(position, std::move(content));
        });
}

void StandardReader::take(standard::CellPosition position, ExternalDataRecordCell&& content) {
    requireInWorksheet(position.row, position.column);
    textBudget_.spend(content.textValue.size());
    ExternalDataRecord record(0, 0, position.row, position.column);
    record.cell = std::move(content);
    deliver(record);
}

IVariableFormat* StandardReader::createVextralNumericFormat(int styleIndex) {
    return references_.formats.create(styleIndex).release();
}

EXCEL_FORMAT_TYPE StandardReader::GetExcelFormatType(int styleIndex) const {
    const standard::NumberFormats::Format* format = references_.formats.at(styleIndex);
    return format ? format->type : EXCEL_FORMAT_NONE;
}

namespace standard {

WorkbookPackage::WorkbookPackage(const std::string& dir)
    : parts(dir), workbookPart(parts.workbookPart()) {}

bool isWorkbook(const std::string& dir) {
    const SilentLibxml2 silent;
    try {
        const WorkbookPackage package(dir);
        readWorkbookPart(package.parts.pathOf(package.workbookPart));
        return mayBeWorkbook(package.parts, package.workbookPart);
    } catch (const CmXmlException&) {
        return false;
    }
}

void listWorksheets(const std::string& dir, std::vector<std::string>& names) {
    const SilentLibxml2 silent;
    const auto& [parts, workbookPart] = WorkbookPackage(dir);
    const WorkbookPart workbook = readWorkbookPart(parts.pathOf(workbookPart));
    const std::vector<Relationship> relationships = parts.relationshipsOf(workbookPart);
    names.clear();
    for (NamedPart& worksheet : worksheetsOf(workbook.sheets, relationships))
        names.push_back(std::move(worksheet.name));
}

}  // namespace standard

}  // namespace dp
