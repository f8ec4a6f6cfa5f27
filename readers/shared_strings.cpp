#include <algorithm>
#include <cstdint>
#include <string_view>

#include <boost/filesystem.hpp>
#include <libxml/xmlreader.h>

#include "readers/excel_xlsx_reader.h"

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

int hexDigit(char digit) {
    if (digit >= '0' && digit <= '9') return digit - '0';
    if (digit >= 'A' && digit <= 'F') return digit - 'A' + 10;
    return 0;
}

}  // namespace

void ExcelXLSXReader::mReadSharedStrings() {
    sharedStrings.clear();
    if (!hasSharedStrings) return;
    const std::string path = xlDir + "/sharedStrings.xml";
    XmlReader reader;
    reader.mInitialize(path);
    textBudget.addPart(path);
    int uniqueCount = 0;
    if (!reader.mGotoElement("sst") || !reader.mReadAttribute(uniqueCount, "uniqueCount")) return;
    sharedStrings.reserve(
        std::min(static_cast<std::size_t>(std::max(uniqueCount, 0)), entriesThatFit(path)));

    std::string text;
    while (reader.readNode() && !endsTable(reader)) {
        if (isText(reader)) {
            if (const char* value = reader.nodeValue()) text += value;
        } else if (endsEntry(reader)) {
            if (IsStringAllBlank(text)) text.clear();
            mParseCharString(text);
            sharedStrings.add(text);
            text.clear();
        }
    }
}

void ExcelXLSXReader::mParseCharString(std::string& text) {
    constexpr std::string_view kEscape = "_x00";
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
