#include "dpxlsx/readers/xlsx/any_worksheet.h"

#include <optional>
#include <string_view>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/xlsx/cell_assembler.h"
#include "dpxlsx/readers/xml/attributes.h"
#include "dpxlsx/readers/xml/known_names.h"

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
                onElement = readText(&CellAssembler::value);
            else if (name == names_.row)
                beginRow();
            else if (name == names_.t && cells_.takesInlineText())
                onElement = readText(&CellAssembler::inlineText);
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

    // Gives `take` of the assembler the text with which the current element begins, empty when it
    // begins with none. True when the reader is then on an element that has not been visited yet.
    // Throws CmXmlException when the document ends.
    bool readText(void (CellAssembler::*take)(std::string_view)) {
        const bool empty = xmlTextReaderIsEmptyElement(reader_.textReader) == 1;
        if (!empty && !xml::readContent(reader_)) throw CmXmlException(kXmlError);
        const char* const value = empty ? nullptr : reader_.nodeValue();
        const std::string_view text = value ? value : "";
        (cells_.*take)(text);
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

}  // namespace dp
