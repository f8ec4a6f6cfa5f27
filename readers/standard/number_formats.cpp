#include "dpxlsx/readers/standard/number_formats.h"

#include <algorithm>
#include <utility>

#include "dpxlsx/formats/automatic_format.h"
#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/formats/sectioned_format.h"
#include "dpxlsx/formats/standard_formats.h"
#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/standard/cell_values.h"
#include "dpxlsx/readers/standard/element_walker.h"

namespace dp::standard {

namespace {

// The built-in formats in which a date, a time or both is shown that has no such format itself.
constexpr int kDate = 14;
constexpr int kTime = 21;
constexpr int kDateTime = 22;
constexpr int kElapsedTime = 46;

bool showsElapsedTime(const NumberFormatCode& code) {
    using Kind = FormatToken::Kind;
    const std::vector<FormatToken>& tokens = code.sections.front().tokens;
    return std::any_of(tokens.begin(), tokens.end(), [](const FormatToken& token) {
        return token.kind == Kind::ElapsedHours || token.kind == Kind::ElapsedMinutes ||
               token.kind == Kind::ElapsedSeconds;
    });
}

std::optional<int> idOf(ElementWalker& walker) {
    return parseIndex(walker.attribute("numFmtId").value_or(""));
}

}  // namespace

void NumberFormats::read(const std::string& path) {
    *this = {};
    std::vector<int> ids;  // of the cell formats, which may come before the codes
    ElementWalker walker(path);
    walker.children([&](std::string_view list) {
        walker.children([&](std::string_view entry) {
            const std::optional<int> id = idOf(walker);
            if (list == "cellXfs" && entry == "xf") ids.push_back(id.value_or(0));
            if (list != "numFmts" || entry != "numFmt" || !id) return;
            addCode(*id, walker.attribute("formatCode").value_or(""));
        });
    });
    walker.finish();
    for (const int id : ids) ofCells_.push_back(indexOf(id));
}

int NumberFormats::ofCell(int style) const {
    const auto position = static_cast<std::size_t>(style);
    return style >= 0 && position < ofCells_.size() ? ofCells_[position] : -1;
}

int NumberFormats::ofDateTime(EXCEL_FORMAT_TYPE type, bool elapsed) {
    return indexOf(elapsed                     ? kElapsedTime
                   : type == EXCEL_FORMAT_DATE ? kDate
                   : type == EXCEL_FORMAT_TIME ? kTime
                                               : kDateTime);
}

const NumberFormats::Format* NumberFormats::at(int index) const {
    const auto position = static_cast<std::size_t>(index);
    return index >= 0 && position < formats_.size() ? &formats_[position] : nullptr;
}

std::unique_ptr<IVariableFormat> NumberFormats::create(int index) const {
    if (const Format* format = at(index))
        return createVariableFormat(parseNumberFormat(format->code));
    return createAutomaticFormat();
}

void NumberFormats::addCode(int id, std::string code) {
    if (code.empty() || code.size() > kFormatCodeSize) return;
    codesSize_ += std::max(code.size(), kLeastFormatCode);
    if (codesSize_ <= kFormatCodes) codeById_[id] = std::move(code);
}

int NumberFormats::indexOf(int id) {
    const auto own = codeById_.find(id);
    const std::string_view text = own == codeById_.end() ? builtInFormatCode(id) : own->second;
    if (text == "General") return -1;  // as without a format
    const bool isOwn = own != codeById_.end();
    if (isOwn && formats_.size() >= kNumberFormats && !indexByCode_.contains(text)) return -1;
    const auto [place, isNew] = indexByCode_.try_emplace(text, static_cast<int>(formats_.size()));
    if (isNew) {
        const NumberFormatCode code = parseNumberFormat(text);
        formats_.push_back({text, formatType(code), showsElapsedTime(code)});
    }
    return place->second;
}

}  // namespace dp::standard
