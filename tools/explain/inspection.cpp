#include "tools/explain/inspection.h"

#include <algorithm>
#include <cctype>
#include <cstdint>
#include <filesystem>
#include <map>
#include <set>
#include <string_view>
#include <vector>

#include "tools/explain/number_formats.h"
#include "tools/explain/worksheet_inspection.h"
#include "tools/package/part_reader.h"

namespace dp::tool {

namespace {

// Far more than spreadsheet programs write; a hostile book must not fill the memory.
constexpr size_t kMostWorksheets = 10000;
constexpr size_t kMostRelationships = 100000;

bool endsInXlsx(const std::string& book) {
    std::string extension = std::filesystem::path(book).extension().string();
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return extension == ".xlsx";
}

std::string lastStep(const std::string& type) { return type.substr(type.rfind('/') + 1); }

std::string folderOfPart(const std::string& part) { return part.substr(0, part.rfind('/') + 1); }

// The name of the part that a relationship of a part in `folder` leads to.
std::string resolved(const std::string& folder, const std::string& target) {
    const bool fromRoot = target.starts_with('/');
    const std::filesystem::path path((fromRoot ? "" : "/" + folder) + target);
    return path.lexically_normal().relative_path().string();
}

bool isTrue(const std::optional<std::string>& text) {
    return text && (*text == "1" || *text == "true" || *text == "on");
}

// The title that an import gives a worksheet with this name when it cleans names.
std::string cleaned(std::string name) {
    constexpr std::string_view kForbidden = "?*/:<>|\"\\";
    constexpr const char* kSpaces = " \t\n\v\f\r";
    for (char& c : name) {
        if (kForbidden.find(c) != std::string_view::npos) c = '_';
    }
    name.erase(name.find_last_not_of(kSpaces) + 1);
    return name.erase(0, name.find_first_not_of(kSpaces));
}

class Inspector {
  public:
    explicit Inspector(const std::string& book) : package_(book) {
        findings_.namedXlsx = endsInXlsx(book);
        findings_.kind = fileKind(book, package_);
        if (findings_.kind == FileKind::Workbook) findWorkbook();
    }

    Findings full(const Imported& imported) {
        if (findings_.kind != FileKind::Workbook) return findings_;
        const std::string styles = located(kStyles, "styles");
        if (!styles.empty()) formats_.read(package_, styles, findings_);
        readStrings();
        if (imported.cleaned) cleanNames();
        for (const WorksheetPart& worksheet : worksheets_) {
            if (imported.leftOut.count(worksheet.name) != 0) continue;
            const auto sheet = imported.sheets.find(worksheet.name);
            const ImportedSheet* found = sheet == imported.sheets.end() ? nullptr : &sheet->second;
            inspectWorksheet(package_, worksheet, {&formats_, texts_, found}, findings_);
        }
        dropTheUnused();
        return findings_;
    }

    Findings quick(const std::string& folder, const std::set<std::string>& leftOut) {
        if (findings_.kind != FileKind::Workbook) return findings_;
        noteRootPrefix(located(kStyles, "styles"), findings_.stylesPrefixed);
        const std::string strings = located(kStrings, "sharedStrings");
        readStringsHead(strings);
        if (folder.empty()) return findings_;
        const bool hasTexts = !strings.empty() && !findings_.stringsWithoutCount;
        for (const WorksheetPart& worksheet : worksheets_) {
            if (leftOut.count(worksheet.name) != 0) continue;
            inspectWorksheetQuickly(package_, worksheet, folder + "/" + worksheet.part, hasTexts,
                                    findings_);
        }
        const bool wanted = findings_.missingTexts.count > 0;
        if (findings_.stringsWithoutCount) findings_.missingTexts = {};
        findings_.stringsWithoutCount = findings_.stringsWithoutCount && wanted;
        return findings_;
    }

  private:
    void cleanNames() {
        for (WorksheetPart& worksheet : worksheets_) worksheet.name = cleaned(worksheet.name);
    }

    // Finds the workbook part under any name, because it leads to all other parts.
    void findWorkbook() {
        readRelationships("_rels/.rels", "");
        const std::string workbook = located(kWorkbook, "officeDocument");
        if (workbook.empty()) {
            findings_.kind = FileKind::OtherArchive;
            return;
        }
        const std::string folder = folderOfPart(workbook);
        const std::string links = folder + "_rels/" + workbook.substr(folder.size()) + ".rels";
        if (!readRelationships(package_.has(links) ? links : package_.similarTo(links), folder)) {
            findings_.broken.push_back(links);
        }
        readWorkbook(workbook);
        findings_.hasStyles = !located(kStyles, "styles").empty();
    }

    // The name of the entry with the part `wanted`: this name itself, else one that differs in
    // letter case, else the one that a relationship of this type names. Another name than `wanted`
    // is noted. Empty when there is no such part.
    std::string located(const std::string& wanted, const std::string& type) {
        if (package_.has(wanted)) return wanted;
        std::string found = package_.similarTo(wanted);
        const auto named = partsByType_.find(type);
        if (found.empty() && named != partsByType_.end()) found = package_.similarTo(named->second);
        if (!found.empty()) noteMoved(wanted, found);
        return found;
    }

    void noteMoved(const std::string& wanted, const std::string& found) {
        const auto same = [&](const MovedPart& part) { return part.wanted == wanted; };
        const auto& moved = findings_.moved;
        if (std::none_of(moved.begin(), moved.end(), same)) {
            findings_.moved.push_back({wanted, found});
        }
    }

    void notePrefix(const std::string& part, const std::string& writtenName, bool& prefixed) {
        if (prefixed) return;
        prefixed = true;
        findings_.notePrefix(part, writtenName);
    }

    // False when the part is missing, malformed or cut off.
    bool readRelationships(const std::string& part, const std::string& folder) {
        PartReader reader(package_, part);
        bool prefixed =
            folder.empty();  // the import does not read the relationships of the package itself
        while (reader.nextElement()) {
            if (reader.isPrefixed() && reader.element().starts_with("Relationship") && !prefixed) {
                notePrefix(part, reader.writtenName(), prefixed);
                findings_.workbookPrefixed = true;
            }
            if (reader.element() == "Relationship") takeRelationship(reader, folder);
        }
        return !reader.isBroken();
    }

    void takeRelationship(const PartReader& reader, const std::string& folder) {
        const std::string type = reader.attribute("Type").value_or("");
        const std::string kind = lastStep(type);
        const std::string id = reader.attribute("Id").value_or("");
        const std::string target = reader.attribute("Target").value_or("");
        if (kind == "worksheet") {
            const bool leads = type.size() > kind.size() + 1 && !target.empty();
            if (leads && !isFull()) worksheetParts_.emplace(id, resolved(folder, target));
        } else if (kind.ends_with("sheet")) {
            if (!isFull()) otherSheets_.insert(id);
        } else if (kind == "officeDocument" || kind == "styles" || kind == "sharedStrings") {
            partsByType_.emplace(kind, resolved(folder, target));
        }
    }

    bool isFull() const {
        return worksheetParts_.size() + otherSheets_.size() >= kMostRelationships;
    }

    void readWorkbook(const std::string& part) {
        PartReader reader(package_, part);
        while (reader.nextElement()) {
            const std::string_view name = reader.element();
            if (reader.isPrefixed() && (name == "sheets" || name == "sheet")) {
                notePrefix(part, reader.writtenName(), findings_.workbookPrefixed);
            }
            if (name == "workbookPr")
                findings_.datesFrom1904 = isTrue(reader.attribute("date1904"));
            if (name == "sheet") takeSheet(reader);
        }
        if (reader.isBroken()) findings_.broken.push_back(part);
    }

    void takeSheet(const PartReader& reader) {
        const auto id = reader.relationshipId();
        if (id && !reader.hasWritten("r:id")) findings_.relationshipPrefixed = true;
        const auto found = worksheetParts_.find(id.value_or(""));
        if (found == worksheetParts_.end()) return noteLost(reader, id.value_or(""));
        if (worksheets_.size() >= kMostWorksheets) return;
        const std::string part = partOf(found->second);
        if (part.empty()) return findings_.broken.push_back(found->second);
        const std::string state = reader.attribute("state").value_or("visible");
        worksheets_.push_back(
            {reader.attribute("name").value_or(""), part, state != "visible", worksheets_.size()});
    }

    // Notes a worksheet without a part. Charts and dialogs are not noted: they have other
    // relationships, and an import leaves them out on purpose.
    void noteLost(const PartReader& reader, const std::string& id) {
        const bool known = id.empty() || otherSheets_.count(id) != 0 || isFull();
        if (known || !findings_.broken.empty()) return;  // a damaged part is the better explanation
        findings_.lostWorksheets.add(reader.attribute("name").value_or(""));
    }

    std::string partOf(const std::string& wanted) {
        if (package_.has(wanted)) return wanted;
        std::string found = package_.similarTo(wanted);
        if (!found.empty()) noteMoved(wanted, found);
        return found;
    }

    void noteRootPrefix(const std::string& part, bool& prefixed) {
        PartReader reader(package_, part);
        const bool found = reader.nextElement() && reader.isPrefixed();
        if (found && !reader.element().empty()) notePrefix(part, reader.writtenName(), prefixed);
    }

    void readStringsHead(const std::string& part) {
        PartReader reader(package_, part);
        for (int i = 0; i < 2 && reader.nextElement(); ++i) takeTable(reader, part);
    }

    // Whether the table has a count matters only when the table has entries.
    void takeTable(const PartReader& reader, const std::string& part) {
        if (reader.element() == "sst") counted_ = reader.attribute("uniqueCount").has_value();
        if (reader.element() != "si") return;
        findings_.stringsWithoutCount = !counted_;
        if (reader.isPrefixed()) notePrefix(part, reader.writtenName(), findings_.stringsPrefixed);
    }

    // Notes which shared texts have phonetic readings, and which have CDATA sections.
    void readStrings() {
        const std::string part = located(kStrings, "sharedStrings");
        if (part.empty()) return;
        PartReader reader(package_, part);
        while (reader.next()) {
            const bool inText = !texts_.phonetic.empty();
            if (reader.isText()) {
                if (reader.isCData() && inText) texts_.cdata.back() = true;
                continue;
            }
            takeTable(reader, part);
            if (reader.element() == "si") {
                texts_.phonetic.push_back(false);
                texts_.cdata.push_back(false);
            }
            if (reader.element() == "rPh" && inText) texts_.phonetic.back() = true;
        }
        texts_.count = tellsOfTexts() ? SIZE_MAX : texts_.phonetic.size();
        if (reader.isBroken()) findings_.broken.push_back(part);
    }

    // Whether another trait already says that all shared texts are missing.
    bool tellsOfTexts() const {
        const auto isTable = [](const MovedPart& part) { return part.wanted == kStrings; };
        const auto& moved = findings_.moved;
        return findings_.stringsWithoutCount || findings_.stringsPrefixed ||
               std::any_of(moved.begin(), moved.end(), isTable);
    }

    // Drops traits of the book that no cell shows. Nothing is dropped when some cells could not be
    // inspected, as in a worksheet with a prefix.
    void dropTheUnused() {
        if (findings_.prefixedWorksheets.count > 0 || !findings_.broken.empty()) return;
        if (findings_.sharedTexts == 0) findings_.stringsWithoutCount = false;
        const auto isDated = [this](const auto& cells) {
            const auto format = findings_.formats.find(cells.first.style);
            return format != findings_.formats.end() && format->second.isDate;
        };
        const auto& cells = findings_.styledCells;
        if (std::none_of(cells.begin(), cells.end(), isDated)) findings_.datesFrom1904 = false;
    }

    Package package_;
    Findings findings_;
    std::map<std::string, std::string> partsByType_;
    std::map<std::string, std::string> worksheetParts_;  // by relationship id
    std::set<std::string> otherSheets_;                  // relationship ids
    std::vector<WorksheetPart> worksheets_;
    NumberFormats formats_;
    bool counted_ = true;  // whether the table of shared texts has its count
    SharedTexts texts_;
};

}  // namespace

Findings inspect(const std::string& book, const Imported& imported) {
    return Inspector(book).full(imported);
}

Findings inspectQuickly(const std::string& book, const std::string& folder,
                        const std::set<std::string>& leftOut) {
    return Inspector(book).quick(folder, leftOut);
}

}  // namespace dp::tool
