#include "tools/explain/worksheet_inspection.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <vector>

#include "tools/options/column_reference.h"
#include "tools/package/part_reader.h"

namespace dp::tool {

namespace {

bool isSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }

// Whether the whole text is a number to spreadsheet programs, or none to an import either. NaN and
// infinity are such: a missing value arrives. Hexadecimal numbers are numbers to an import alone.
bool isNumber(const std::string& text) {
    char* end = nullptr;
    const double value = std::strtod(text.c_str(), &end);
    if (!std::isfinite(value)) return true;
    const bool found = end != text.c_str();
    while (isSpace(*end)) ++end;
    return found && *end == '\0' && text.find_first_of("xX") == text.npos;
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

constexpr unsigned kWorksheetColumns = 16384;
constexpr unsigned kWorksheetRows = 1048576;

// Where an import puts the cells.
class CellPosition {
  public:
    void beginRow(const std::optional<std::string>& number) {
        const auto given = rowNumber(number);
        rowIsGiven_ = given.has_value();
        row_ = given.value_or(row_ + 1);
        column_ = 0;
    }

    // A cell without a reference follows the one before it.
    void beginCell(const std::optional<std::string>& reference) {
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

    unsigned row() const { return row_; }        // 1-based
    unsigned column() const { return column_; }  // 1-based
    // Whether the reference is in lower case, because of which the cell arrives in another column.
    bool isLowerCase() const { return isLowerCase_; }

  private:
    static bool isLower(char c) { return c >= 'a' && c <= 'z'; }

    // An import takes all letters for upper-case ones, and lower-case letters have codes that are
    // higher by 32.
    static unsigned columnOfImport(const std::string& letters) {
        unsigned column = 0;
        for (const char letter : letters) column = column * 26 + static_cast<unsigned>(letter - 64);
        return column;
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

    unsigned row_ = 0;
    unsigned column_ = 0;
    bool rowIsGiven_ = true;
    bool isLowerCase_ = false;
};

// What the tag of a cell says.
struct CellTag {
    std::string type;
    std::string style;
    std::string place;
};

// What was found in a cell until it ended.
struct CellContent {
    bool hasFormula = false;
    bool hasValue = false;
    bool valueInPieces = false;
    bool textInPieces = false;  // the inline text
    bool phonetic = false;
    size_t runs = 0;
};

// The value or inline text that the reader is in.
struct OpenText {
    static constexpr int kNone = -2;  // neither this nor the next number is a depth

    bool isValue = false;
    int depth = kNone;
    size_t pieces = 0;
};

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
        if (reader_.depth() != text_.depth + 1) return;
        if (++text_.pieces == 1) return text_.isValue ? countValue() : noteReference();
        (text_.isValue ? content_.valueInPieces : content_.textInPieces) = true;
    }

    void takeElement(std::string_view name) {
        inPhonetic_ = inPhonetic_ && reader_.depth() > phoneticDepth_;
        const bool isValue = name == "v";
        const bool inText = name == "t" && cell_.type == "inlineStr" && isInline();
        if (inText) content_.textInPieces = false;  // of several texts an import takes the last one
        text_ = {isValue, isValue || inText ? reader_.depth() : OpenText::kNone};
        if (name == "c") beginCell();
        if (name == "row") beginRow();
        if (name == "is") inlineDepth_ = reader_.depth();
        if (name == "f") content_.hasFormula = true;
        if (name == "t" && !inPhonetic_ && isInline()) ++content_.runs;
        if (name == "rPh") {
            inPhonetic_ = true;
            phoneticDepth_ = reader_.depth();
            content_.phonetic = true;
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
        position_.beginRow(reader_.attribute("r"));
    }

    void beginCell() {
        endCell();
        const auto reference = reader_.attribute("r");
        cell_ = {reader_.attribute("t").value_or(""), reader_.attribute("s").value_or(""),
                 at(reference)};
        position_.beginCell(reference);
        inlineDepth_ = 0;
    }

    // Called for cells with content only.
    void noteReference() {
        if (!position_.isLowerCase() || !isRead()) return;
        const ImportedSheet* const sheet = tables_.imported;
        const bool fails = position_.column() > kWorksheetColumns;
        const bool arrives = sheet != nullptr && sheet->columns.count(position_.column()) != 0;
        if (!fails && !arrives) return;
        if (findings_.lowerCase.count == 0)
            findings_.lowerCaseColumn = columnLetters(position_.column());
        findings_.lowerCase.add(cell_.place);
        findings_.lowerCaseFails = findings_.lowerCaseFails || fails;
    }

    void endCell() {
        if (isRead()) noteCell();
        if (content_.runs > 0 && isName()) nameIsText_ = true;
        content_ = {};
    }

    void noteCell() {
        const bool isInlineText = cell_.type == "inlineStr";
        if (content_.hasFormula && !content_.hasValue && cell_.type != "str")
            findings_.formulas.add(cell_.place);
        if (isInlineText && content_.phonetic) findings_.phoneticCells.add(cell_.place);
        if (isInlineText && content_.runs > 0 && content_.hasValue) {
            findings_.inlineValues.add(cell_.place);
        } else if (isInlineText && content_.runs > 1) {
            findings_.runs.add(cell_.place);
        }
        const bool inPieces = content_.hasValue ? content_.valueInPieces : content_.textInPieces;
        if (inPieces && cell_.type != "e") findings_.pieces.add(cell_.place);
    }

    void countValue() {
        content_.hasValue = true;
        if (!isRead()) return;
        if (cell_.type != "e") noteReference();
        if (isTakenForNumber()) checkNumber();
        const bool isNumber = cell_.type.empty() || cell_.type == "n";
        if (cell_.type == "s") countSharedText();
        if (cell_.type == "d") findings_.isoDates.add(cell_.place);
        if (cell_.type == "e") findings_.errors.add(cell_.place);
        if (isName()) return noteName(isNumber);
        if (isNumber || cell_.type == "b") countStyle();
    }

    // An import treats Booleans and types that it does not know as numbers.
    bool isTakenForNumber() const {
        constexpr std::string_view kOthers[] = {"s", "str", "inlineStr", "e", "d"};
        return std::find(std::begin(kOthers), std::end(kOthers), cell_.type) == std::end(kOthers);
    }

    void checkNumber() {
        const std::string text = reader_.text();
        const auto note = [&](WrongTexts& texts) {
            texts.add(cell_.place, text.substr(0, kLongest));
        };
        if (cell_.type != "b") {
            if (!isNumber(text)) note(findings_.notNumbers);
            return;
        }
        const std::string word = lowerWord(text);
        const auto isOne = [&word](auto... words) { return ((word == words) || ...); };
        if (isOne("true", "on")) {
            findings_.booleanWords.add(cell_.place);
        } else if (!isOne("0", "1", "false", "off")) {
            note(findings_.notBooleans);
        }
    }

    // Whether the import reads the cell: it is not above the data, nor in a column that is left
    // out.
    bool isRead() const {
        const ImportedSheet* sheet = tables_.imported;
        if (sheet == nullptr) return true;
        return (isName() || position_.row() >= sheet->firstDataRow) &&
               sheet->leftOut.count(position_.column()) == 0;
    }

    bool isName() const {
        return tables_.imported != nullptr && position_.row() == tables_.imported->nameRow &&
               position_.row() < tables_.imported->firstDataRow;
    }

    void noteName(bool isNumber) {
        if (isNumber) {
            numbersAsNames_.add(cell_.place);
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
        if (!known) findings_.missingTexts.add(cell_.place);
        const auto has = [index](const std::vector<bool>& texts) {
            return index >= 0 && static_cast<size_t>(index) < texts.size() &&
                   texts[static_cast<size_t>(index)];
        };
        if (has(tables_.texts.phonetic)) findings_.phoneticTexts.add(cell_.place);
        if (has(tables_.texts.cdata)) findings_.cdataTexts.add(cell_.place);
    }

    void countStyle() {
        const NumberFormats* const formats = tables_.formats;
        if (formats == nullptr) return;
        int style = StyledColumn::kBoolean;
        if (cell_.type != "b") {
            const long index = std::strtol(cell_.style.c_str(), nullptr, 10);
            if (index < 0 || index >= static_cast<long>(formats->size())) return;
            style = cell_.style.empty() ? StyledColumn::kNone : static_cast<int>(index);
            if (findings_.formats.count(style) == 0) {
                findings_.formats.emplace(style, formats->of(style));
            }
        }
        StyledCells* const cells = cellsOf({worksheet_.place, position_.column(), style});
        if (cells != nullptr) cells->cells.add(cell_.place);
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
        cells.reference = columnReference(worksheet_.name, sheet->key, position_.column());
        const auto column = sheet->columns.find(position_.column());
        if (column != sheet->columns.end()) cells.kind = column->second;
        cells.isChosen = sheet->chosen.count(position_.column()) != 0;
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

    PartReader reader_;
    const WorksheetPart& worksheet_;
    const Tables tables_;
    Findings& findings_;

    CellPosition position_;
    CellTag cell_;
    CellContent content_;
    OpenText text_;
    int inlineDepth_ = 0;  // of the inline text of the cell, 0 for none
    bool inPhonetic_ = false;
    int phoneticDepth_ = 0;
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
