#include <algorithm>
#include <array>
#include <cstddef>
#include <string>
#include <string_view>

#include <libxml/xmlreader.h>

#include "readers/attributes.h"
#include "readers/cell_reference.h"
#include "readers/cm_xml_cast.h"
#include "readers/excel_xlsx_reader.h"

// The cells of one worksheet part, in a single forward pass.
namespace dp {

namespace {

enum class CellKind { Number, SharedString, Text, InlineText, Error };

CellKind kindOf(std::string_view type) {
    if (type == "s") return CellKind::SharedString;
    if (type == "str") return CellKind::Text;
    if (type == "inlineStr") return CellKind::InlineText;
    if (type == "e") return CellKind::Error;
    return CellKind::Number;  // Booleans and ISO dates included
}

// The names that the pass looks for, as the document's own copies: one pointer comparison tells
// whether a node has such a name.
struct Names {
    explicit Names(XmlReader& reader)
        : row(reader.knownName("row")),
          c(reader.knownName("c")),
          v(reader.knownName("v")),
          t(reader.knownName("t")),
          r(reader.knownName("r")),
          s(reader.knownName("s")) {}

    const char* row;
    const char* c;
    const char* v;
    const char* t;
    const char* r;
    const char* s;
};

// The index in a shared-string cell: the optional sign and digits of `text`, or -1 for a number
// beyond any table. Throws CmXmlException for anything else.
long sharedStringIndex(const char* text) {
    constexpr long kBeyond = 0x7FFFFFFF;
    const bool negative = *text == '-';
    if (*text == '-' || *text == '+') ++text;
    if (*text == '\0') throw CmXmlException(kXmlError);
    long index = 0;
    for (; *text != '\0'; ++text) {
        if (*text < '0' || *text > '9') throw CmXmlException(kXmlError);
        index = std::min(index * 10 + (*text - '0'), kBeyond);
    }
    return index == kBeyond || (negative && index != 0) ? -1 : index;
}

}  // namespace

// The state of one pass over a worksheet part.
class WorksheetPass {
  public:
    WorksheetPass(ExcelXLSXReader& owner, const std::string& path) : owner_(owner) {
        text_.cell.type = CELL_TEXT;
        reader_.mInitialize(path);
    }

    void run() {
        try {
            readCells();
        } catch (...) {
            // Cells read before an error are still delivered, unless the provider itself failed.
            if (!delivering_) deliverWaiting();
            throw;
        }
        deliverWaiting();
    }

  private:
    // A cell on its way to the provider.
    struct WaitingCell {
        unsigned row;
        unsigned column;
        long sharedString;  // its index, or -1 for a number
        double number;
        NumberKind kind;
    };

    void readCells() {
        const Names names(reader_);
        if (reader_.nodeType() != XML_READER_TYPE_ELEMENT && !reader_.readToElement()) return;
        bool onElement = true;
        while (onElement) {
            onElement = false;  // until a handler stops on an element that it did not handle
            const char* name = reader_.nodeName();
            if (name == names.c)
                beginCell(names);
            else if (name == names.v)
                onElement = readValue();
            else if (name == names.row)
                beginRow();
            else if (name == names.t && kind_ == CellKind::InlineText)
                onElement = readInlineText();
            if (!onElement) onElement = reader_.readToElement();
        }
    }

    void beginRow() {
        Attributes attributes(reader_);
        const char* text = attributes.find("r");
        int number = 0;
        // A row whose number cannot be read counts as a row without a number.
        const bool numbered = text && CmXmlCast::instance().mCast(number, text);
        place_.beginRow(numbered ? &number : nullptr);
    }

    void beginCell(const Names& names) {
        kind_ = CellKind::Number;
        style_ = -1;
        Attributes attributes(reader_);
        bool placed = false;
        for (const xmlAttr* a = attributes.first(); a; a = a->next) {
            if (a->ns) continue;
            const char* name = reinterpret_cast<const char*>(a->name);
            if (name == names.r) {
                place_.beginCell(attributes.valueOf(a));
                placed = true;
            } else if (name == names.t) {
                kind_ = kindOf(attributes.valueOf(a));
            } else if (name == names.s) {
                CmXmlCast::instance().mCast(style_, attributes.valueOf(a));
            }
        }
        if (!placed) place_.beginCell(nullptr);
    }

    // Moves to the text of the current element; null when it has none. Throws CmXmlException when
    // the document ends.
    const char* readText() {
        if (xmlTextReaderIsEmptyElement(reader_.textReader) == 1) return nullptr;
        if (!xml::readContent(reader_)) throw CmXmlException(kXmlError);
        const char* text = reader_.nodeValue();
        return text && *text != '\0' ? text : nullptr;
    }

    // True when the reader is on an element that has not been visited yet.
    bool readValue() {
        const bool empty = xmlTextReaderIsEmptyElement(reader_.textReader) == 1;
        const char* text = readText();
        if (text) deliver(text);
        kind_ = CellKind::Number;
        style_ = -1;
        return !empty && !text && reader_.nodeType() == XML_READER_TYPE_ELEMENT;
    }

    bool readInlineText() {
        const bool empty = xmlTextReaderIsEmptyElement(reader_.textReader) == 1;
        const char* text = readText();
        if (text) deliverText(text);
        return !empty && !text && reader_.nodeType() == XML_READER_TYPE_ELEMENT;
    }

    void deliver(const char* text) {
        switch (kind_) {
            case CellKind::Number:
                deliverNumber(text);
                break;
            case CellKind::SharedString:
                deliverSharedString(sharedStringIndex(text));
                break;
            case CellKind::Text:
            case CellKind::InlineText:
                deliverText(text);
                break;
            case CellKind::Error:
                break;
        }
    }

    void deliverNumber(const char* text) {
        WaitingCell cell{place_.row(), place_.column(), -1, 0.0, {}};
        if (style_ >= 0 && static_cast<std::size_t>(style_) < owner_.numberKinds.size())
            cell.kind = owner_.numberKinds[static_cast<std::size_t>(style_)];
        CmXmlCast::instance().mCast(cell.number, text);
        if (waitingCount_ == 0)
            deliver(cell);
        else
            wait(cell);
    }

    void deliverSharedString(long index) {
        if (index < 0 || static_cast<std::size_t>(index) >= owner_.sharedStrings.size()) return;
        owner_.sharedStrings.fetchPlace(static_cast<std::size_t>(index));
        wait({place_.row(), place_.column(), index, 0.0, {}});
    }

    void deliverText(const char* text) {
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
    void wait(const WaitingCell& cell) {
        if (waitingCount_ == kWaiting) deliverOldest();
        waiting_[(oldest_ + waitingCount_++) % kWaiting] = cell;
        if (waitingCount_ <= kWaiting / 2) return;
        const WaitingCell& between = waiting_[(oldest_ + waitingCount_ - kWaiting / 2) % kWaiting];
        if (between.sharedString >= 0)
            owner_.sharedStrings.fetchText(static_cast<std::size_t>(between.sharedString));
    }

    void deliverWaiting() {
        while (waitingCount_ > 0) deliverOldest();
    }

    void deliverOldest() {
        const WaitingCell& cell = waiting_[oldest_];
        oldest_ = (oldest_ + 1) % kWaiting;
        --waitingCount_;
        delivering_ = true;
        deliver(cell);
        delivering_ = false;
    }

    void deliver(const WaitingCell& cell) {
        if (cell.sharedString < 0) {
            number_.cell.type = cell.kind.type;
            number_.cell.formatIndex = cell.kind.formatIndex;
            number_.cell.numValue = cell.number;
            return deliverAt(cell.row, cell.column, number_);
        }
        const auto index = static_cast<std::size_t>(cell.sharedString);
        text_.cell.textValue = owner_.sharedStrings[index];
        if (!text_.cell.textValue.empty()) deliverTextAt(cell.row, cell.column);
    }

    void deliverTextAt(unsigned row, unsigned column) {
        owner_.textBudget.spend(text_.cell.textValue.size());
        deliverAt(row, column, text_);
    }

    void deliverAt(unsigned row, unsigned column, ExternalDataRecord& record) {
        requireInWorksheet(row, column);
        record.row = row;
        record.column = column;
        owner_.deliver(record);
    }

    static constexpr std::size_t kWaiting = 16;

    ExcelXLSXReader& owner_;
    XmlReader reader_;
    CellPlace place_;
    CellKind kind_ = CellKind::Number;
    int style_ = -1;
    std::array<WaitingCell, kWaiting> waiting_;
    std::size_t oldest_ = 0;
    std::size_t waitingCount_ = 0;
    bool delivering_ = false;
    ExternalDataRecord number_{0, 0, 0, 0};
    ExternalDataRecord text_{0, 0, 0, 0};
};

void readWorksheet(ExcelXLSXReader& reader, const std::string& target) {
    const std::string part = resolveTarget(reader.packageDir, target);
    reader.repeatedParts.visit(part);
    reader.textBudget.addPart(part);
    WorksheetPass(reader, part).run();
}

void ExcelXLSXReader::mReadExcel2007Worksheet(const std::string& target) {
    resolveNumberKinds();  // a derived reader may have changed the style table
    readWorksheet(*this, target);
}

}  // namespace dp
