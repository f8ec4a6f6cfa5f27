#include "dpxlsx/readers/xlsx/any_shared_strings.h"

#include <string_view>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/xlsx/shared_string_entries.h"
#include "dpxlsx/readers/xml/attributes.h"
#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

namespace {

bool hasName(const XmlReader& reader, std::string_view name) { return reader.nodeName() == name; }

// White space is text only inside a `t`. Elsewhere it is indentation, which libxml2 reports as
// significant too.
bool isInsideText(const XmlReader& reader) {
    const xmlNode* node = xmlTextReaderCurrentNode(reader.textReader);
    return node && node->parent && node->parent->name &&
           xmlStrEqual(node->parent->name, reinterpret_cast<const xmlChar*>("t"));
}

bool isText(const XmlReader& reader) {
    const int type = reader.nodeType();
    return type == XML_READER_TYPE_TEXT ||
           (type == XML_READER_TYPE_SIGNIFICANT_WHITESPACE && isInsideText(reader));
}

bool endsEntry(const XmlReader& reader) {
    const int type = reader.nodeType();
    if (type != XML_READER_TYPE_END_ELEMENT &&
        !(type == XML_READER_TYPE_ELEMENT && xmlTextReaderIsEmptyElement(reader.textReader) == 1))
        return false;
    return hasName(reader, "si");
}

bool endsTable(const XmlReader& reader) {
    return reader.nodeType() == XML_READER_TYPE_END_ELEMENT && hasName(reader, "sst");
}

}  // namespace

void readAnySharedStrings(const std::string& path, SharedStringTable& table) {
    SharedStringEntries entries(table, path);
    XmlReader reader;
    reader.mInitialize(path);
    if (!reader.mGotoElement("sst")) return;
    Attributes attributes(reader);
    const char* const uniqueCount = attributes.find("uniqueCount");
    if (!uniqueCount) return;
    entries.begin(uniqueCount);
    while (reader.readNode() && !endsTable(reader)) {
        if (isText(reader)) {
            if (const char* value = reader.nodeValue()) entries.addText(value);
        } else if (endsEntry(reader)) {
            entries.endEntry();
        }
    }
}

}  // namespace dp
