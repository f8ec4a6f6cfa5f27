#include <algorithm>
#include <cstdint>
#include <string_view>

#include <boost/filesystem.hpp>
#include <libxml/xmlreader.h>

#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/shared_string_entries.h"
#include "dpxlsx/readers/xml/attributes.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "dpxlsx/store/text_cleaning.h"

// The shared-string table and the escapes of its texts.
namespace dp {

namespace {

// The shortest entry is "<si/>", so a part cannot hold more of them than this. A declared count is
// only a hint, and a hostile one must not allocate.
std::size_t entriesThatFit(const std::string& path) {
    constexpr std::uintmax_t kShortestEntry = 5;  // bytes
    boost::system::error_code error;
    const std::uintmax_t size = boost::filesystem::file_size(path, error);
    return error ? 0 : static_cast<std::size_t>(size / kShortestEntry);
}

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

constexpr std::string_view kEscape = "_x00";  // how each begins

int hexDigit(char digit) {
    if (digit >= '0' && digit <= '9') return digit - '0';
    if (digit >= 'A' && digit <= 'F') return digit - 'A' + 10;
    return 0;
}

}  // namespace

SharedStringEntries::SharedStringEntries(SharedStringTable& table, const std::string& path)
    : table_(table), path_(path) {
    table_.clear();
}

void SharedStringEntries::begin(const char* uniqueCount) {
    int count = 0;
    CmXmlCast::instance().mCast(count, uniqueCount);
    table_.reserve(std::min(static_cast<std::size_t>(std::max(count, 0)), entriesThatFit(path_)));
}

void SharedStringEntries::endEntry() {
    addEntry(text_);
    text_.clear();
}

void SharedStringEntries::addEntry(std::string_view text) {
    if (isAllSpaces(text)) return table_.add({});
    if (text.find(kEscape) == text.npos) return table_.add(text);
    std::string decoded(text);
    ExcelXLSXReader::mParseCharString(decoded);
    table_.add(decoded);
}

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

void ExcelXLSXReader::mReadSharedStrings() {
    if (!hasSharedStrings) return;
    const std::string path = xlDir + "/sharedStrings.xml";
    if (!readPlainSharedStrings(path, sharedStrings)) readAnySharedStrings(path, sharedStrings);
    textBudget.addPart(path);
}

void ExcelXLSXReader::mParseCharString(std::string& text) {
    constexpr std::size_t kLength = 7;  // of "_x000D_"
    std::size_t escape = text.find(kEscape);
    if (escape == text.npos) return;

    std::string decoded;
    std::size_t copied = 0;
    for (; escape != text.npos; escape = text.find(kEscape, copied)) {
        decoded.append(text, copied, escape - copied);
        const std::string_view code = std::string_view(text).substr(escape, kLength);
        copied = escape + kLength;
        if (code == "_x005F_") {
            decoded += '_';
        } else if (code >= "_x0001_" && code <= "_x001F_") {
            // The check above guarantees a fifth character, but the text may end there: then there
            // is no sixth.
            const int low = code.size() > 5 ? hexDigit(code[5]) : 0;
            decoded += static_cast<char>((code[4] == '1' ? 16 : 0) + low);
        } else {
            decoded += kEscape;
            copied = escape + kEscape.size();
        }
    }
    decoded.append(text, std::min(copied, text.size()), text.npos);
    text = std::move(decoded);
}

}  // namespace dp
