#include "tools/inspection.h"

#include <algorithm>
#include <cctype>
#include <cstdint>
#include <filesystem>
#include <map>
#include <vector>

#include "tools/number_formats.h"
#include "tools/part_reader.h"
#include "tools/worksheet_inspection.h"

namespace dp::tool {

namespace {

// Far more than spreadsheet programs write: what comes after only fills the memory.
constexpr size_t kMostWorksheets = 10000;
constexpr size_t kMostRelationships = 100000;

constexpr const char* kWorkbook = "xl/workbook.xml";
constexpr const char* kStyles = "xl/styles.xml";
constexpr const char* kStrings = "xl/sharedStrings.xml";

bool endsInXlsx(const std::string& book) {
    std::string extension = std::filesystem::path(book).extension().string();
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return extension == ".xlsx";
}

std::string lastStep(const std::string& type) { return type.substr(type.rfind('/') + 1); }

std::string folderOf(const std::string& part) { return part.substr(0, part.rfind('/') + 1); }

// The part that a relationship of a part in `folder` leads to.
std::string resolved(const std::string& folder, const std::string& target) {
    const bool fromRoot = target.starts_with('/');
    const std::filesystem::path path((fromRoot ? "" : "/" + folder) + target);
    return path.lexically_normal().relative_path().string();
}

bool isTrue(const std::optional<std::string>& text) {
    return text && (*text == "1" || *text == "true" || *text == "on");
}

class Inspector {
  public:
    explicit Inspector(const std::string& book) : package_(book) {
        findings_.namedXlsx = endsInXlsx(book);
        findings_.kind = fileKind(book, package_);
        if (findings_.kind == FileKind::Workbook) findWorkbook();
    }

    Findings full() {
        if (findings_.kind != FileKind::Workbook) return findings_;
        const std::string styles = located(kStyles, "styles");
        if (!styles.empty()) formats_.read(package_, styles, findings_);
        readStrings();
        for (const WorksheetPart& worksheet : worksheets_) {
            inspectWorksheet(package_, worksheet, {&formats_, textCount()}, findings_);
        }
        return findings_;
    }

    Findings quick(const std::string& folder) {
        if (findings_.kind != FileKind::Workbook) return findings_;
        noteRootPrefix(located(kStyles, "styles"), findings_.stylesPrefixed);
        const std::string strings = located(kStrings, "sharedStrings");
        readStringsHead(strings);
        if (folder.empty()) return findings_;
        for (const WorksheetPart& worksheet : worksheets_) {
            inspectWorksheetQuickly(package_, worksheet, folder + "/" + worksheet.part,
                                    !strings.empty(), findings_);
        }
        return findings_;
    }

  private:
    // The workbook leads to all other parts, wherever it is itself.
    void findWorkbook() {
        readRelationships("_rels/.rels", "");
        const std::string workbook = located(kWorkbook, "officeDocument");
        if (workbook.empty()) {
            findings_.kind = FileKind::OtherArchive;
            return;
        }
        const std::string folder = folderOf(workbook);
        const std::string links = folder + "_rels/" + workbook.substr(folder.size()) + ".rels";
        if (!readRelationships(package_.has(links) ? links : package_.similarTo(links), folder)) {
            findings_.broken.push_back(links);
        }
        readWorkbook(workbook);
        findings_.hasStyles = !located(kStyles, "styles").empty();
    }

    // The name of the entry with the part: the wanted one, else one of another letter case, else
    // the one that relationships of this type name; noted when it is not the wanted one. Empty
    // when there is none.
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

    // False when there is no such part or it breaks off.
    bool readRelationships(const std::string& part, const std::string& folder) {
        PartReader reader(package_, part);
        bool prefixed = folder.empty();  // the import does not read the package's own
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
        const std::string type = lastStep(reader.attribute("Type").value_or(""));
        const std::string part = resolved(folder, reader.attribute("Target").value_or(""));
        if (type == "worksheet" && worksheetParts_.size() < kMostRelationships) {
            worksheetParts_.emplace(reader.attribute("Id").value_or(""), part);
        } else if (type == "officeDocument" || type == "styles" || type == "sharedStrings") {
            partsByType_.emplace(type, part);
        }
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
        if (found == worksheetParts_.end() || worksheets_.size() >= kMostWorksheets) return;
        const std::string part = partOf(found->second);
        if (part.empty()) return findings_.broken.push_back(found->second);
        const std::string state = reader.attribute("state").value_or("visible");
        worksheets_.push_back({reader.attribute("name").value_or(""), part, state != "visible"});
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

    // A table without entries has nothing to lose.
    void takeTable(const PartReader& reader, const std::string& part) {
        if (reader.element() == "sst") counted_ = reader.attribute("uniqueCount").has_value();
        if (reader.element() != "si") return;
        findings_.stringsWithoutCount = !counted_;
        if (reader.isPrefixed()) notePrefix(part, reader.writtenName(), findings_.stringsPrefixed);
    }

    // Counts the texts, those with a phonetic one beside them, and those in CDATA sections.
    void readStrings() {
        const std::string part = located(kStrings, "sharedStrings");
        if (part.empty()) return;
        PartReader reader(package_, part);
        bool phonetic = false;
        bool cdata = false;
        while (reader.next()) {
            if (reader.isText()) {
                findings_.cdataTexts += reader.isCData() && !cdata;
                cdata = cdata || reader.isCData();
                continue;
            }
            const std::string_view name = reader.element();
            takeTable(reader, part);
            if (name == "si") {
                ++texts_;
                phonetic = cdata = false;
            }
            if (name == "rPh" && !phonetic) {
                phonetic = true;
                ++findings_.phoneticTexts;
            }
        }
        if (reader.isBroken()) findings_.broken.push_back(part);
    }

    // How many texts a cell can take: all when another trait says what becomes of the table.
    size_t textCount() const {
        const auto isTable = [](const MovedPart& part) { return part.wanted == kStrings; };
        const auto& moved = findings_.moved;
        const bool told = findings_.stringsWithoutCount || findings_.stringsPrefixed ||
                          std::any_of(moved.begin(), moved.end(), isTable);
        return told ? SIZE_MAX : texts_;
    }

    Package package_;
    Findings findings_;
    std::map<std::string, std::string> partsByType_;
    std::map<std::string, std::string> worksheetParts_;  // by relationship id
    std::vector<WorksheetPart> worksheets_;
    NumberFormats formats_;
    bool counted_ = true;  // the table of shared texts
    size_t texts_ = 0;     // in it
};

}  // namespace

Findings inspect(const std::string& book) { return Inspector(book).full(); }

Findings inspectQuickly(const std::string& book, const std::string& folder) {
    return Inspector(book).quick(folder);
}

}  // namespace dp::tool
