#include "tools/worksheet_inspection.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <vector>

#include "tools/part_reader.h"

namespace dp::tool {

namespace {

// One forward pass over the cells.
class Pass {
  public:
    Pass(Package& package, const WorksheetPart& worksheet, const Tables& tables, Findings& findings)
        : reader_(package, worksheet.part),
          worksheet_(worksheet),
          tables_(tables),
          findings_(findings) {}

    void run() {
        while (!prefixed_ && reader_.next()) takeNode();  // an import finds no cells there
        endCell();
        if (hasCells_ && worksheet_.hidden) findings_.hiddenWorksheets.add(worksheet_.name);
        if (reader_.isBroken()) findings_.broken.push_back(worksheet_.part);
    }

    // Stops at the first cell.
    void findPrefix() {
        while (!prefixed_ && reader_.nextElement()) notePrefix();
    }

    // Stops at the first of these places.
    void find(const Places& places) {
        while (places.count == 0 && reader_.next()) takeNode();
    }

  private:
    void takeNode() {
        if (reader_.isText()) {
            if (inValue_) countValue();
            inValue_ = false;
        } else {
            takeElement(reader_.element());
        }
    }

    void takeElement(std::string_view name) {
        inPhonetic_ = inPhonetic_ && reader_.depth() > phoneticDepth_;
        inValue_ = name == "v";
        if (name == "c") beginCell();
        if (name == "v" || name == "is") hasCells_ = true;
        if (name == "t" && !inPhonetic_) ++runs_;
        if (name == "rPh") {
            inPhonetic_ = true;
            phoneticDepth_ = reader_.depth();
            phonetic_ = true;
        }
        if (name == "mergeCell" && hasCells_)
            findings_.mergedRanges.add(at(reader_.attribute("ref")));
        notePrefix();
    }

    void beginCell() {
        endCell();
        type_ = reader_.attribute("t").value_or("");
        style_ = reader_.attribute("s").value_or("");
        place_ = at(reader_.attribute("r"));
    }

    void endCell() {
        if (type_ == "inlineStr" && phonetic_) findings_.phoneticCells.add(place_);
        if (type_ == "inlineStr" && runs_ > 0 && hasValue_) {
            findings_.inlineValues.add(place_);
        } else if (type_ == "inlineStr" && runs_ > 1) {
            findings_.runs.add(place_);
        }
        runs_ = 0;
        hasValue_ = false;
        phonetic_ = false;
    }

    void countValue() {
        hasValue_ = true;
        if (type_ == "s") countSharedText();
        if (type_ == "d") findings_.isoDates.add(place_);
        if (type_ == "e") findings_.errors.add(place_);
        if (!style_.empty() && (type_.empty() || type_ == "n")) countStyle();
    }

    void countSharedText() {
        ++findings_.sharedTexts;
        const long index = std::strtol(reader_.text().c_str(), nullptr, 10);
        const bool known = index >= 0 && static_cast<size_t>(index) < tables_.texts;
        if (!known) findings_.missingTexts.add(place_);
    }

    void countStyle() {
        const NumberFormats* const formats = tables_.formats;
        const long style = std::strtol(style_.c_str(), nullptr, 10);
        const bool known =
            style >= 0 && formats != nullptr && style < static_cast<long>(formats->size());
        if (!known) return;
        const int index = static_cast<int>(style);
        auto found = findings_.formats.find(index);
        if (found == findings_.formats.end()) {
            found = findings_.formats.emplace(index, formats->of(index)).first;
        }
        found->second.cells.add(place_);
    }

    void notePrefix() {
        const bool ofCells = reader_.element() == "c" || reader_.element() == "v";
        if (!ofCells || !reader_.isPrefixed()) return;
        prefixed_ = true;
        findings_.prefixedWorksheets.add(worksheet_.name);
        findings_.notePrefix(worksheet_.part, reader_.writtenName());
    }

    std::string at(const std::optional<std::string>& reference) const {
        constexpr size_t kLongest = 32;
        if (!reference) return worksheet_.name;
        return worksheet_.name + "!" + reference->substr(0, kLongest);
    }

    PartReader reader_;
    const WorksheetPart& worksheet_;
    const Tables tables_;
    Findings& findings_;

    std::string type_;
    std::string style_;
    std::string place_;
    bool inValue_ = false;
    bool hasValue_ = false;  // the cell
    size_t runs_ = 0;
    bool phonetic_ = false;
    bool inPhonetic_ = false;
    int phoneticDepth_ = 0;
    bool hasCells_ = false;
    bool prefixed_ = false;
};

bool isQuote(char c) { return c == '"' || c == '\''; }

// Whether the letter stands in quotes anywhere in the file, in an encoding of one or two bytes:
// only then can a cell be of this type. This is over before a reader of XML has made its first
// steps.
bool mayHaveType(const std::string& path, char type) {
    constexpr size_t kMargin = 4;  // characters that stand around the end of a block
    std::ifstream file(path, std::ios::binary);
    std::vector<char> block((1 << 18) + 2 * kMargin);
    size_t kept = 0;
    while (file) {
        file.read(block.data() + kept, static_cast<std::streamsize>(block.size() - kept));
        const size_t size = kept + static_cast<size_t>(file.gcount());
        const char* const begin = block.data();
        const char* const end = begin + size;
        for (const char* at = begin; at + 1 < end; ++at) {
            at = static_cast<const char*>(std::memchr(at, type, static_cast<size_t>(end - at)));
            if (at == nullptr) break;
            for (const std::ptrdiff_t width : {1, 2}) {
                const bool inside = at - begin >= width && end - at > width;
                if (inside && isQuote(at[-width]) && isQuote(at[width])) return true;
            }
        }
        kept = std::min(size, kMargin);
        std::memmove(block.data(), end - kept, kept);
    }
    return false;
}

bool hasPrefixedRoot(Package& package, const WorksheetPart& worksheet) {
    PartReader reader(package, worksheet.part);
    return reader.nextElement() && reader.isPrefixed();
}

}  // namespace

void inspectWorksheet(Package& package, const WorksheetPart& worksheet, const Tables& tables,
                      Findings& findings) {
    Pass(package, worksheet, tables, findings).run();
}

void inspectWorksheetQuickly(Package& package, const WorksheetPart& worksheet,
                             const std::string& unpacked, bool hasTexts, Findings& findings) {
    const Tables none{nullptr, 0};
    if (hasPrefixedRoot(package, worksheet)) {
        return Pass(package, worksheet, none, findings).findPrefix();
    }
    if (findings.isoDates.count == 0 && mayHaveType(unpacked, 'd')) {
        Findings found;
        Pass(package, worksheet, none, found).find(found.isoDates);
        findings.isoDates = found.isoDates;
    }
    if (!hasTexts && findings.missingTexts.count == 0 && mayHaveType(unpacked, 's')) {
        Findings found;
        Pass(package, worksheet, none, found).find(found.missingTexts);
        findings.missingTexts = found.missingTexts;
    }
}

}  // namespace dp::tool
