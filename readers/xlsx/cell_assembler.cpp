#include "dpxlsx/readers/xlsx/cell_assembler.h"

#include <algorithm>
#include <cstddef>
#include <string>

#include "dpxlsx/readers/xml/cm_xml_cast.h"

namespace dp {

namespace {

// Where a shared-string cell points to: the optional sign and digits of `text`, or -1 for a number
// beyond any table. Throws CmXmlException for anything else.
long sharedStringIndex(std::string_view text) {
    constexpr long kBeyond = 0x7FFFFFFF;
    const bool negative = text.front() == '-';
    if (negative || text.front() == '+') text.remove_prefix(1);
    if (text.empty()) throw CmXmlException(kXmlError);
    long index = 0;
    for (const char c : text) {
        if (c < '0' || c > '9') throw CmXmlException(kXmlError);
        index = std::min(index * 10 + (c - '0'), kBeyond);
    }
    return index == kBeyond || (negative && index != 0) ? -1 : index;
}

}  // namespace

CellAssembler::CellAssembler(ExcelXLSXReader& owner, std::size_t passedOver)
    : owner_(owner), package_(*owner.opened_), passedOver_(passedOver) {
    text_.cell.type = CELL_TEXT;
}

CellAssembler::Kind CellAssembler::kindOf(std::string_view type) {
    if (type == "s") return Kind::SharedString;
    if (type == "str") return Kind::Text;
    if (type == "inlineStr") return Kind::InlineText;
    if (type == "e") return Kind::Error;
    return Kind::Number;  // Booleans and ISO dates included
}

void CellAssembler::beginRow(std::optional<std::string_view> number) {
    int row = 0;
    // A row whose number cannot be read counts as a row without a number.
    const bool numbered = number && CmXmlCast::instance().mCast(row, number->data());
    place_.beginRow(numbered ? &row : nullptr);
}

void CellAssembler::beginCell(std::optional<std::string_view> reference, std::string_view type,
                              std::string_view style) {
    place_.beginCell(reference ? reference->data() : nullptr);
    kind_ = kindOf(type);
    style_ = -1;
    if (!style.empty()) CmXmlCast::instance().mCast(style_, style.data());
}

void CellAssembler::value(std::string_view text) {
    if (!text.empty()) {
        switch (kind_) {
            case Kind::Number:
                deliverNumber(text);
                break;
            case Kind::SharedString:
                deliverSharedString(sharedStringIndex(text));
                break;
            case Kind::Text:
            case Kind::InlineText:
                deliverText(text);
                break;
            case Kind::Error:
                break;
        }
    }
    kind_ = Kind::Number;
    style_ = -1;
}

void CellAssembler::inlineText(std::string_view text) {
    if (!text.empty()) deliverText(text);
}

void CellAssembler::deliverNumber(std::string_view text) {
    WaitingCell cell{place_.row(), place_.column(), -1, 0.0, {}};
    if (style_ >= 0 && static_cast<std::size_t>(style_) < package_.numberKinds.size())
        cell.kind = package_.numberKinds[static_cast<std::size_t>(style_)];
    CmXmlCast::instance().mCast(cell.number, text.data());
    if (waitingCount_ == 0)
        deliver(cell);
    else
        wait(cell);
}

void CellAssembler::deliverSharedString(long index) {
    if (index < 0 || static_cast<std::size_t>(index) >= package_.sharedStrings.size()) return;
    package_.sharedStrings.fetchPlace(static_cast<std::size_t>(index));
    wait({place_.row(), place_.column(), index, 0.0, {}});
}

void CellAssembler::deliverText(std::string_view text) {
    deliverWaiting();
    std::string& value = text_.cell.textValue;
    value = text;
    if (ExcelXmlReader::IsStringAllBlank(value)) return;
    ExcelXLSXReader::mParseCharString(value);
    deliverTextAt(place_.row(), place_.column());
}

// A shared string can be anywhere in memory and is likely to be a cache miss. It is prefetched
// here, while the cell waits in a queue; the cells are delivered in their order a little later,
// when their texts have arrived in the cache.
void CellAssembler::wait(const WaitingCell& cell) {
    if (waitingCount_ == kWaiting) deliverOldest();
    waiting_[(oldest_ + waitingCount_++) % kWaiting] = cell;
    if (waitingCount_ <= kWaiting / 2) return;
    const WaitingCell& between = waiting_[(oldest_ + waitingCount_ - kWaiting / 2) % kWaiting];
    if (between.sharedString >= 0)
        package_.sharedStrings.fetchText(static_cast<std::size_t>(between.sharedString));
}

void CellAssembler::deliverWaiting() {
    while (waitingCount_ > 0) deliverOldest();
}

void CellAssembler::deliverOldest() {
    const WaitingCell& cell = waiting_[oldest_];
    oldest_ = (oldest_ + 1) % kWaiting;
    --waitingCount_;
    delivering_ = true;
    deliver(cell);
    delivering_ = false;
}

void CellAssembler::deliver(const WaitingCell& cell) {
    if (cell.sharedString < 0) {
        number_.cell.type = cell.kind.type;
        number_.cell.formatIndex = cell.kind.formatIndex;
        number_.cell.numValue = cell.number;
        return deliverAt(cell.row, cell.column, number_);
    }
    const auto index = static_cast<std::size_t>(cell.sharedString);
    text_.cell.textValue = package_.sharedStrings[index];
    if (!text_.cell.textValue.empty()) deliverTextAt(cell.row, cell.column);
}

void CellAssembler::deliverTextAt(unsigned row, unsigned column) {
    if (delivered_ >= passedOver_) package_.textBudget.spend(text_.cell.textValue.size());
    deliverAt(row, column, text_);
}

void CellAssembler::deliverAt(unsigned row, unsigned column, ExternalDataRecord& record) {
    if (delivered_++ < passedOver_) return;
    requireInWorksheet(row, column);
    record.row = row;
    record.column = column;
    owner_.deliver(record);
}

}  // namespace dp
