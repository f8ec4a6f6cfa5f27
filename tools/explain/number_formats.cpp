#include "tools/explain/number_formats.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>
#include <utility>

namespace dp::tool {

namespace {

// The most that spreadsheet programs write; a hostile book must not fill the memory.
constexpr size_t kMostStyles = 65536;
constexpr size_t kLongestCode = 255;
// An import leaves out longer codes, in bytes.
constexpr size_t kLongestImported = 1024;

char lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

bool isOneOf(char c, std::string_view letters) { return letters.find(c) != letters.npos; }

// Whether it is "[h]", "[mm]" or the like, an elapsed time. Everything else in brackets is a
// colour, a condition or a locale.
bool countsTime(std::string_view inBrackets) {
    const auto sameLetter = [&](char c) { return lower(c) == lower(inBrackets.front()); };
    return !inBrackets.empty() && isOneOf(lower(inBrackets.front()), "hms") &&
           std::all_of(inBrackets.begin(), inBrackets.end(), sameLetter);
}

// The built-in date formats, whose codes are not written in packages. The East Asian ones have a
// different code in each language.
constexpr std::pair<int, const char*> kBuiltInDates[] = {
    {14, "m/d/yyyy"},      {15, "d-mmm-yy"},      {16, "d-mmm"},     {17, "mmm-yy"},
    {18, "h:mm AM/PM"},    {19, "h:mm:ss AM/PM"}, {20, "h:mm"},      {21, "h:mm:ss"},
    {22, "m/d/yyyy h:mm"}, {45, "mm:ss"},         {46, "[h]:mm:ss"}, {47, "mm:ss.0"},
};

UsedFormat builtIn(int id) {
    for (const auto& [date, code] : kBuiltInDates) {
        if (id == date) return {code, true, FormatOrigin::Usual};
    }
    const bool eastAsian = (id >= 27 && id <= 36) || (id >= 50 && id <= 58);
    return {"built-in " + std::to_string(id), eastAsian, FormatOrigin::Usual};
}

// Whether an import has a format of its own for the id, which it takes whatever the book says.
bool isImportedBuiltIn(int id) {
    return (id >= 1 && id <= 11) || (id >= 14 && id <= 22) || (id >= 37 && id <= 48);
}

int number(const std::optional<std::string>& text) {
    return text ? static_cast<int>(std::strtol(text->c_str(), nullptr, 10)) : 0;
}

bool isWanted(const PartReader& reader) {
    const std::string_view name = reader.element();
    return name == "numFmts" || name == "numFmt" || name == "cellXfs" || name == "xf";
}

}  // namespace

void NumberFormats::read(Package& package, const std::string& name, Findings& findings) {
    PartReader reader(package, name);
    std::string section;
    while (reader.nextElement()) {
        if (reader.depth() == 1) section = reader.element();
        if (isWanted(reader) && reader.isPrefixed() && !findings.stylesPrefixed) {
            findings.stylesPrefixed = true;
            findings.notePrefix(name, reader.writtenName());
        }
        if (reader.element() == "numFmts") declared_ = number(reader.attribute("count"));
        if (reader.element() == "numFmt") takeCode(reader, section == "numFmts");
        if (section == "cellXfs" && reader.element() == "xf" && formatIds_.size() < kMostStyles) {
            formatIds_.push_back(number(reader.attribute("numFmtId")));
        }
    }
    if (reader.isBroken()) findings.broken.push_back(name);
}

void NumberFormats::takeCode(const PartReader& reader, bool isListed) {
    const std::string text = reader.attribute("formatCode").value_or("");
    if (text.empty() || codes_.size() + others_.size() >= kMostStyles) return;
    const int id = number(reader.attribute("numFmtId"));
    const bool isTooLong = text.size() > kLongestImported;
    const bool isCounted = isTooLong || taken_++ < declared_;
    const std::string beginning = text.substr(0, kLongestCode);
    if (!isListed) {
        others_.emplace(id, beginning);
        return;
    }
    const FormatOrigin origin = isTooLong               ? FormatOrigin::TooLong
                                : isImportedBuiltIn(id) ? FormatOrigin::BuiltInId
                                : isCounted             ? FormatOrigin::Usual
                                                        : FormatOrigin::Uncounted;
    codes_[id] = {beginning, origin};
}

UsedFormat NumberFormats::of(int style) const {
    if (style == StyledColumn::kNone) {
        const UsedFormat first = of(0);
        return {first.code, first.isDate, FormatOrigin::FirstStyle};
    }
    const int id = formatIds_[static_cast<size_t>(style)];
    if (const auto own = codes_.find(id); own != codes_.end()) {
        const Code& code = own->second;
        return {code.text, isDateCode(code.text), code.origin};
    }
    const auto other = others_.find(id);
    if (other == others_.end() || isImportedBuiltIn(id)) return builtIn(id);
    // Spreadsheet programs know no format under the id.
    return {other->second, false, FormatOrigin::Unlisted};
}

bool isDateCode(const std::string& code) {
    const std::string_view text = code;
    for (size_t i = 0; i < text.size() && text[i] != ';'; ++i) {
        switch (text[i]) {
            case '"':
                i = std::min(text.find('"', i + 1), text.size());
                break;
            case '\\':
            case '_':
            case '*':
                ++i;
                break;
            case '[': {
                const size_t end = std::min(text.find(']', i), text.size());
                if (countsTime(text.substr(i + 1, end - i - 1))) return true;
                i = end;
                break;
            }
            default:
                if (isOneOf(lower(text[i]), "dmyhs")) return true;
        }
    }
    return false;
}

}  // namespace dp::tool
