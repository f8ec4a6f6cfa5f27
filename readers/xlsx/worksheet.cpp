#include <optional>
#include <string>
#include <string_view>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/xlsx/cell_assembler.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/worksheet_sources.h"
#include "dpxlsx/readers/xml/attributes.h"

// The cells of one worksheet part, in a single forward pass.
namespace dp {

namespace {

// Reads any worksheet part with libxml2's text reader.
class WorksheetPass {
  public:
    WorksheetPass(const std::string& path, CellAssembler& cells)
        : cells_(cells), names_((reader_.mInitialize(path), reader_)) {}

    void run() {
        if (reader_.nodeType() != XML_READER_TYPE_ELEMENT && !reader_.readToElement()) return;
        bool onElement = true;
        while (onElement) {
            onElement = false;  // until a handler stops on an element that it did not handle
            const char* name = reader_.nodeName();
            if (name == names_.c)
                beginCell();
            else if (name == names_.v)
                onElement = readValue();
            else if (name == names_.row)
                beginRow();
            else if (name == names_.t && cells_.takesInlineText())
                onElement = readInlineText();
            if (!onElement) onElement = reader_.readToElement();
        }
    }

  private:
    // The names that the pass looks for, as the document's own table has them: one pointer
    // comparison tells whether a node has such a name.
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

    void beginRow() {
        Attributes attributes(reader_);
        const char* number = attributes.find("r");
        cells_.beginRow(number ? std::optional<std::string_view>(number) : std::nullopt);
    }

    void beginCell() {
        Attributes attributes(reader_);
        std::optional<std::string> reference;
        std::string type;
        std::string style;
        for (const xmlAttr* a = attributes.first(); a; a = a->next) {
            if (a->ns) continue;
            const char* name = reinterpret_cast<const char*>(a->name);
            if (name == names_.r)
                reference = attributes.valueOf(a);
            else if (name == names_.t)
                type = attributes.valueOf(a);
            else if (name == names_.s)
                style = attributes.valueOf(a);
        }
        cells_.beginCell(reference, type, style);
    }

    // Moves to the text with which the current element begins; empty when it begins with none.
    // Throws CmXmlException when the document ends.
    std::string_view readText() {
        if (xmlTextReaderIsEmptyElement(reader_.textReader) == 1) return {};
        if (!xml::readContent(reader_)) throw CmXmlException(kXmlError);
        const char* text = reader_.nodeValue();
        return text ? std::string_view(text) : std::string_view();
    }

    // True when the reader is on an element that has not been visited yet.
    bool readValue() {
        const bool empty = xmlTextReaderIsEmptyElement(reader_.textReader) == 1;
        const std::string_view text = readText();
        cells_.value(text);
        return !empty && text.empty() && reader_.nodeType() == XML_READER_TYPE_ELEMENT;
    }

    bool readInlineText() {
        const bool empty = xmlTextReaderIsEmptyElement(reader_.textReader) == 1;
        const std::string_view text = readText();
        cells_.inlineText(text);
        return !empty && text.empty() && reader_.nodeType() == XML_READER_TYPE_ELEMENT;
    }

    CellAssembler& cells_;
    XmlReader reader_;
    Names names_;
};

}  // namespace

void readAnyWorksheet(const std::string& path, CellAssembler& cells) {
    WorksheetPass(path, cells).run();
}

void readWorksheet(ExcelXLSXReader& reader, const std::string& target) {
    const std::string part = resolveTarget(reader.packageDir, target);
    reader.repeatedParts.visit(part);
    reader.textBudget.addPart(part);
    CellAssembler plain(reader);
    if (plain.take([&] { return readPlainWorksheet(part, plain); })) return;
    CellAssembler any(reader, plain.delivered());
    any.take([&] {
        readAnyWorksheet(part, any);
        return true;
    });
}

void ExcelXLSXReader::mReadExcel2007Worksheet(const std::string& target) {
    resolveNumberKinds();  // a derived reader may have changed the style table
    readWorksheet(*this, target);
}

}  // namespace dp
