#include "tools/explain/worksheet_inspection.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <vector>

#include <climits>

#include "tools/options/column_reference.h"
#include "tools/package/part_reader.h"

namespace dp::tool {

namespace {

bool isSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }

// Whether the whole text is a number to an import. NaN and infinity count as numbers here, because
// they do not arrive as another number.
bool isNumber(const std::string& text) {
    char* end = nullptr;
    const double value = std::strtod(text.c_str(), &end);
    const bool found = end != text.c_str();
    while (isSpace(*end)) ++end;
    return found && (*end == '\0' || !std::isfinite(value));
}

// The text without the white space around it, in lower case.
std::string lowerWord(std::string_view text) {
    while (!text.empty() && isSpace(text.front())) text.remove_prefix(1);
    while (!text.empty() && isSpace(text.back())) text.remove_suffix(1);
    std::string word(text);
    std::transform(word.begin(), word.end(), word.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return word;
}

// One forward pass over the cells.
class Pass {
  public:
    Pass(Package& package, const WorksheetPart& worksheet, const Tables& tables, Findings& findings)
        : reader_(package, worksheet.part),
          worksheet_(worksheet),
          tables_(tables),
          findings_(findings) {}

    void run() {
        while (!prefixed_ && reader_.next())
            takeNode();  // an import finds no cells in a worksheet with a prefix
        endCell();
        if (tables_.imported != nullptr && worksheet_.hidden) {
            findings_.hiddenWorksheets.add(worksheet_.name);
        }
        if (!nameIsText_ && numbersAsNames_.count > 0) addNumbersAsNames();
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
            takeText();
        } else {
            takeElement(reader_.element());
        }
    }

    // Comments and CDATA sections divide a text into pieces, of which an import takes the first.
    void takeText() {
        if (reader_.depth() != contentDepth_ + 1) return;
        if (++pieces_ == 1) return inValue_ ? countValue() : noteReference();
        (inValue_ ? valueInPieces_ : textInPieces_) = true;
    }

    void takeElement(std::string_view name) {
        inPhonetic_ = inPhonetic_ && reader_.depth() > phoneticDepth_;
        inValue_ = name == "v";
        const bool inText = name == "t" && type_ == "inlineStr" && isInline();
        if (inText) textInPieces_ = false;  // of several texts an import takes the last one
        contentDepth_ = inValue_ || inText ? reader_.depth() : kNoContent;
        pieces_ = 0;
        if (name == "c") beginCell();
        if (name == "row") beginRow();
        if (name == "is") inlineDepth_ = reader_.depth();
        if (name == "f") hasFormula_ = true;
        if (name == "t" && !inPhonetic_ && isInline()) ++runs_;
        if (name == "rPh") {
            inPhonetic_ = true;
            phoneticDepth_ = reader_.depth();
            phonetic_ = true;
        }
        if (name == "mergeCell" && tables_.imported != nullptr) noteMerged();
        notePrefix();
    }

    // Whether the reader is within the inline text of the cell.
    bool isInline() const { return inlineDepth_ > 0 && reader_.depth() > inlineDepth_; }

    void noteMerged() {
        const auto range = reader_.attribute("ref");
        if (range && range->find(':') != std::string::npos) findings_.mergedRanges.add(at(range));
    }

    void beginRow() {
        endCell();
        const auto given = rowNumber(reader_.attribute("r"));
        rowIsGiven_ = given.has_value();
        row_ = given.value_or(row_ + 1);
        column_ = 0;
    }

    void beginCell() {
        endCell();
        type_ = reader_.attribute("t").value_or("");
        style_ = reader_.attribute("s").value_or("");
        const auto reference = reader_.attribute("r");
        place_ = at(reference);
        takeReference(reference);
        inlineDepth_ = 0;
    }

    // A cell without a reference follows the one before it.
    void takeReference(const std::optional<std::string>& reference) {
        ++column_;
        isLowerCase_ = false;
        if (!reference) return;
        const size_t digits = std::min(reference->find_first_of("0123456789"), reference->size());
        const std::string letters = reference->substr(0, digits);
        if (const auto column = columnNumber(letters)) {
            isLowerCase_ = std::any_of(letters.begin(), letters.end(), isLower);
            column_ = isLowerCase_ ? columnOfImport(letters) : *column;
        }
        if (rowIsGiven_) return;
        row_ = rowNumber(reference->substr(digits)).value_or(row_);
    }

    static bool isLower(char c) { return c >= 'a' && c <= 'z'; }

    // The column in which an import puts the cell: it takes all letters for upper-case ones, and
    // lower-case letters have codes that are higher by 32.
    static unsigned columnOfImport(const std::string& letters) {
        unsigned column = 0;
        for (const char letter : letters) column = column * 26 + static_cast<unsigned>(letter - 64);
        return column;
    }

    // Called for cells with content only.
    void noteReference() {
        if (!isLowerCase_ || !isRead()) return;
        const ImportedSheet* const sheet = tables_.imported;
        const bool fails = column_ > kWorksheetColumns;
        const bool arrives = sheet != nullptr && sheet->columns.count(column_) != 0;
        if (!fails && !arrives) return;
        if (findings_.lowerCase.count == 0) findings_.lowerCaseColumn = columnLetters(column_);
        findings_.lowerCase.add(place_);
        findings_.lowerCaseFails = findings_.lowerCaseFails || fails;
    }

    // As an import reads it: the number that the text begins with, or one behind all rows for a row
    // that no worksheet has.
    static std::optional<unsigned> rowNumber(const std::optional<std::string>& text) {
        if (!text) return std::nullopt;
        char* end = nullptr;
        const long value = std::strtol(text->c_str(), &end, 10);
        if (end == text->c_str()) return std::nullopt;
        return value > 0 && value <= kWorksheetRows ? static_cast<unsigned>(value)
                                                    : kWorksheetRows + 1;
    }

    void endCell() {
        if (isRead()) noteCell();
        if (runs_ > 0 && isName()) nameIsText_ = true;
        hasFormula_ = false;
        runs_ = 0;
        hasValue_ = false;
        phonetic_ = false;
        valueInPieces_ = false;
        textInPieces_ = false;
    }

    void noteCell() {
        const bool isInlineText = type_ == "inlineStr";
        if (hasFormula_ && !hasValue_ && type_ != "str") findings_.formulas.add(place_);
        if (isInlineText && phonetic_) findings_.phoneticCells.add(place_);
        if (isInlineText && runs_ > 0 && hasValue_) {
            findings_.inlineValues.add(place_);
        } else if (isInlineText && runs_ > 1) {
            findings_.runs.add(place_);
        }
        const bool inPieces = hasValue_ ? valueInPieces_ : textInPieces_;
        if (inPieces && type_ != "e") findings_.pieces.add(place_);
    }

    void countValue() {
        hasValue_ = true;
        if (!isRead()) return;
        if (type_ != "e") noteReference();
        if (isTakenForNumber()) checkNumber();
        const bool isNumber = type_.empty() || type_ == "n";
        if (type_ == "s") countSharedText();
        if (type_ == "d") findings_.isoDates.add(place_);
        if (type_ == "e") findings_.errors.add(place_);
        if (isName()) return noteName(isNumber);
        if (isNumber || type_ == "b") countStyle();
    }

    // An import treats Booleans and types that it does not know as numbers.
    bool isTakenForNumber() const {
        constexpr std::string_view kOthers[] = {"s", "str", "inlineStr", "e", "d"};
        return std::find(std::begin(kOthers), std::end(kOthers), type_) == std::end(kOthers);
    }

    void checkNumber() {
        const std::string text = reader_.text();
        const std::string word = type_ == "b" ? lowerWord(text) : std::string();
        if (word == "true") findings_.booleanWords.add(place_);
        if (word == "true" || word == "false" || isNumber(text)) return;
        if (findings_.notNumbers.count == 0) findings_.notNumber = text.substr(0, kLongest);
        findings_.notNumbers.add(place_);
    }

    // Whether the import reads the cell: it is not above the data, nor in a column that is left
    // out.
    bool isRead() const {
        const ImportedSheet* sheet = tables_.imported;
        if (sheet == nullptr) return true;
        return (isName() || row_ >= sheet->firstDataRow) && sheet->leftOut.count(column_) == 0;
    }

    bool isName() const {
        return tables_.imported != nullptr && row_ == tables_.imported->nameRow &&
               row_ < tables_.imported->firstDataRow;
    }

    void noteName(bool isNumber) {
        if (isNumber) {
            numbersAsNames_.add(place_);
        } else {
            nameIsText_ = true;
        }
    }

    void addNumbersAsNames() {
        Places& all = findings_.numbersAsNames;
        if (all.count == 0) all.first = numbersAsNames_.first;
        all.count += numbersAsNames_.count;
    }

    void countSharedText() {
        ++findings_.sharedTexts;
        const long index = std::strtol(reader_.text().c_str(), nullptr, 10);
        const bool known = index >= 0 && static_cast<size_t>(index) < tables_.texts.count;
        if (!known) findings_.missingTexts.add(place_);
        const auto has = [index](const std::vector<bool>& texts) {
            return index >= 0 && static_cast<size_t>(index) < texts.size() &&
                   texts[static_cast<size_t>(index)];
        };
        if (has(tables_.texts.phonetic)) findings_.phoneticTexts.add(place_);
        if (has(tables_.texts.cdata)) findings_.cdataTexts.add(place_);
    }

    // A cell without a style has the first one.
    void countStyle() {
        const NumberFormats* const formats = tables_.formats;
        if (formats == nullptr) return;
        int style = StyledColumn::kBoolean;
        if (type_ != "b") {
            const long index = std::strtol(style_.c_str(), nullptr, 10);
            if (index < 0 || index >= static_cast<long>(formats->size())) return;
            style = static_cast<int>(index);
            if (findings_.formats.count(style) == 0) {
                findings_.formats.emplace(style, formats->of(style));
            }
        }
        StyledCells* const cells = cellsOf({worksheet_.place, column_, style});
        if (cells != nullptr) cells->cells.add(place_);
    }

    // Null when there are already too many combinations of column and style.
    StyledCells* cellsOf(const StyledColumn& key) {
        constexpr size_t kMost = 200000;
        auto& all = findings_.styledCells;
        auto found = all.find(key);
        if (found == all.end()) {
            if (all.size() >= kMost) return nullptr;
            found = all.emplace(key, StyledCells()).first;
            describe(found->second);
        }
        return &found->second;
    }

    void describe(StyledCells& cells) const {
        const ImportedSheet* sheet = tables_.imported;
        if (sheet == nullptr) return;
        cells.reference = columnReference(worksheet_.name, sheet->key, column_);
        const auto column = sheet->columns.find(column_);
        if (column != sheet->columns.end()) cells.kind = column->second;
        cells.isChosen = sheet->chosen.count(column_) != 0;
    }

    void notePrefix() {
        const bool ofCells = reader_.element() == "c" || reader_.element() == "v";
        if (!ofCells || !reader_.isPrefixed()) return;
        prefixed_ = true;
        findings_.prefixedWorksheets.add(worksheet_.name);
        findings_.notePrefix(worksheet_.part, reader_.writtenName());
    }

    std::string at(const std::optional<std::string>& reference) const {
        if (!reference) return worksheet_.name;
        return worksheet_.name + "!" + reference->substr(0, kLongest);
    }

    static constexpr size_t kLongest = 32;  // bytes of what is quoted from a cell
    static constexpr int kNoContent = -2;   // neither this nor the value plus one is a depth
    static constexpr unsigned kWorksheetColumns = 16384;
    static constexpr unsigned kWorksheetRows = 1048576;

    PartReader reader_;
    const WorksheetPart& worksheet_;
    const Tables tables_;
    Findings& findings_;

    std::string type_;
    std::string style_;
    std::string place_;
    bool inValue_ = false;
    int contentDepth_ = kNoContent;  // of the value or inline text
    size_t pieces_ = 0;              // of its text
    bool hasValue_ = false;          // the cell
    bool valueInPieces_ = false;
    bool textInPieces_ = false;
    size_t runs_ = 0;
    bool phonetic_ = false;
    bool inPhonetic_ = false;
    int phoneticDepth_ = 0;
    bool hasFormula_ = false;
    int inlineDepth_ = 0;  // of the inline text of the cell, 0 for none
    unsigned row_ = 0;     // 1-based
    unsigned column_ = 0;  // 1-based, where an import puts the cell
    bool rowIsGiven_ = true;
    bool isLowerCase_ = false;  // the reference
    bool nameIsText_ = false;
    Places numbersAsNames_;  // in the row of names
    bool prefixed_ = false;
};

bool isQuote(char c) { return c == '"' || c == '\''; }

// Whether the letter is in quotes anywhere in the file, in an encoding of one or two bytes a
// character: only then can a cell have this type. This is far faster than reading the XML.
bool mayHaveType(const std::string& path, char type) {
    constexpr size_t kMargin = 4;  // characters that may be split by the end of a block
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
    const SharedTexts noTexts;
    const Tables none{nullptr, noTexts, nullptr};
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
