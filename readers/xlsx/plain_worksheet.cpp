#include "dpxlsx/readers/xlsx/plain_worksheet.h"

#include <cstddef>
#include <cstring>
#include <optional>
#include <string_view>

#include "dpxlsx/formats/digits.h"
#include "dpxlsx/readers/xlsx/cell_assembler.h"

namespace dp {

namespace {

bool isUpper(char c) { return c >= 'A' && c <= 'Z'; }
bool isLower(char c) { return c >= 'a' && c <= 'z'; }
bool isOfNumber(char c) { return isDigit(c) || c == '.' || c == '-' || c == 'E' || c == '+'; }

// Moves `p` behind `literal` if that stands there. The zeros behind the bytes read so far are in no
// literal, so that it need not be looked for byte by byte.
template <std::size_t Size>
bool take(char*& p, const char (&literal)[Size]) {
    static_assert(Size - 1 <= PlainXml::kZeros);
    if (std::memcmp(p, literal, Size - 1) != 0) return false;
    p += Size - 1;
    return true;
}

template <class Is>
std::string_view takeAll(char*& p, Is is) {
    char* const begin = p;
    while (is(*p)) ++p;
    return {begin, static_cast<std::size_t>(p - begin)};
}

class PlainWorksheet {
  public:
    PlainWorksheet(PlainXml& xml, CellAssembler& cells) : xml_(xml), cells_(cells) {}

    // False when the part is not plain.
    bool run() {
        node_ = xml_.next();
        while (node_ == PlainXml::Node::Start || node_ == PlainXml::Node::Empty ||
               node_ == PlainXml::Node::End || node_ == PlainXml::Node::Text) {
            if (visit()) continue;
            if (xml_.isInsideRoot()) takeCells();
            node_ = xml_.next();
        }
        return node_ == PlainXml::Node::Finished;
    }

  private:
    // True when node_ is one that is still to be visited.
    bool visit() {
        if (node_ != PlainXml::Node::Start && node_ != PlainXml::Node::Empty) return false;
        const std::string_view name = xml_.name();
        if (name == "c") {
            cells_.beginCell(attribute("r"), attribute("t").value_or(""),
                             attribute("s").value_or(""));
        } else if (name == "row") {
            cells_.beginRow(attribute("r"));
        } else if (name == "v") {
            return giveText([this](std::string_view text) { cells_.value(text); });
        } else if (name == "t" && cells_.takesInlineText()) {
            return giveText([this](std::string_view text) { cells_.inlineText(text); });
        }
        return false;
    }

    std::optional<std::string_view> attribute(std::string_view name) {
        const char* value = xml_.attribute(name);
        return value ? std::optional<std::string_view>(value) : std::nullopt;
    }

    // Gives the text with which the element begins, or none.
    template <class Give>
    bool giveText(const Give& give) {
        if (node_ == PlainXml::Node::Empty) {
            give({});
            return false;
        }
        node_ = xml_.next();
        if (node_ == PlainXml::Node::NotPlain) return true;
        const bool text = node_ == PlainXml::Node::Text;
        give(text ? xml_.text() : std::string_view());
        return !text;
    }

    void takeCells() {
        while (takeCell()) {
        }
    }

    // <c r="B7" s="1" t="s"><v>12</v></c>, which nearly all cells look like. False, and nothing has
    // happened, for anything else; the same cell may come by visit() then.
    bool takeCell() {
        char* p = xml_.ahead();
        if (!take(p, "<c r=\"")) return false;
        char* const reference = p;
        const std::size_t letters = takeAll(p, isUpper).size();
        const std::size_t digits = takeAll(p, isDigit).size();
        if (letters == 0 || letters > 3 || digits == 0 || digits > 7) return false;
        char* const referenceEnd = p;
        std::string_view style;
        if (take(p, "\" s=\"")) style = takeAll(p, isDigit);
        char* const styleEnd = p;
        std::string_view type;
        if (take(p, "\" t=\"")) type = takeAll(p, isLower);
        char* const typeEnd = p;
        if (!take(p, "\"><v>")) return false;
        char* const value = p;
        takeAll(p, isOfNumber);
        char* const valueEnd = p;
        if (value == valueEnd || !take(p, "</v></c>")) return false;
        *referenceEnd = *styleEnd = *typeEnd = *valueEnd = '\0';
        cells_.beginCell(
            std::string_view(reference, static_cast<std::size_t>(referenceEnd - reference)), type,
            style);
        cells_.value({value, static_cast<std::size_t>(valueEnd - value)});
        xml_.skipTo(p);
        return true;
    }

    PlainXml& xml_;
    CellAssembler& cells_;
    PlainXml::Node node_ = PlainXml::Node::NotPlain;
};

}  // namespace

bool readPlainWorksheet(const std::string& path, CellAssembler& cells, ReadingWindow window) {
    PlainXml xml(window);
    return xml.open(path) && PlainWorksheet(xml, cells).run();
}

}  // namespace dp
