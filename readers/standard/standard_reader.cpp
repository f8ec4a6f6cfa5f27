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

using standard::PackageParts;
using standard::Relationship;

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
    : StandardReader(PackageParts(dir), std::move(shortDate), missing, receiver, helper) {}

StandardReader::StandardReader(PackageParts parts, std::string shortDate, double missing,
                               IExcelDataProvider* receiver, IDateTimeVariableFormat* helper)
    : ExcelXLSXReader(parts.pathOf(parts.workbookPart()), std::move(shortDate), missing, receiver,
                      helper),
      parts_(std::move(parts)) {}

StandardReader::~StandardReader() = default;

void StandardReader::mReadExcelWorkbook() {
    const SilentLibxml2 silent;
    const std::string workbookPart = parts_.workbookPart();
    const standard::WorkbookPart workbook = standard::readWorkbookPart(parts_.pathOf(workbookPart));
    const std::vector<Relationship> relationships = parts_.relationshipsOf(workbookPart);
    references_.date1904 = workbook.date1904;
    readReferences(workbookPart, relationships);
    std::vector<unsigned> emptySheets;
    for (const auto& [name, part] : worksheetsOf(workbook.sheets, relationships)) {
        beginWorksheet(name);
        readWorksheet(parts_.pathOf(part));
        if (worksheetEmpty) emptySheets.push_back(static_cast<unsigned>(worksheetIndex - 1));
    }
    removeEmptyWorksheets(emptySheets);
}

// A workbook may have no styles and no shared strings.
void StandardReader::readReferences(const std::string& workbookPart,
                                    const std::vector<Relationship>& relationships) {
    const auto pathByType = [&](std::string_view type) {
        return parts_.pathByType(relationships, type, workbookPart);
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

bool isWorkbook(const std::string& dir) {
    const SilentLibxml2 silent;
    const PackageParts parts(dir);
    try {
        const std::string part = parts.workbookPart();
        readWorkbookPart(parts.pathOf(part));
        return mayBeWorkbook(parts, part);
    } catch (const CmXmlException&) {
        return false;
    }
}

void listWorksheets(const std::string& dir, std::vector<std::string>& names) {
    const SilentLibxml2 silent;
    const PackageParts parts(dir);
    const std::string workbookPart = parts.workbookPart();
    const WorkbookPart workbook = readWorkbookPart(parts.pathOf(workbookPart));
    const std::vector<Relationship> relationships = parts.relationshipsOf(workbookPart);
    names.clear();
    for (NamedPart& worksheet : worksheetsOf(workbook.sheets, relationships))
        names.push_back(std::move(worksheet.name));
}

}  // namespace standard

}  // namespace dp
