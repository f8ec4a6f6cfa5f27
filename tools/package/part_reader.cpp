#include "tools/package/part_reader.h"

#include <algorithm>
#include <iterator>
#include <string_view>

#include "tools/host/interrupt.h"

namespace dp::tool {

namespace {

constexpr std::string_view kNamespaces[] = {
    "http://schemas.openxmlformats.org/spreadsheetml/2006/main",
    "http://purl.oclc.org/ooxml/spreadsheetml/main",
    "http://schemas.openxmlformats.org/package/2006/relationships",
};

constexpr const char* kRelationships[] = {
    "http://schemas.openxmlformats.org/officeDocument/2006/relationships",
    "http://purl.oclc.org/ooxml/officeDocument/relationships",
};

const xmlChar* xml(const char* text) { return reinterpret_cast<const xmlChar*>(text); }

std::string_view view(const xmlChar* text) {
    return text == nullptr ? std::string_view() : reinterpret_cast<const char*>(text);
}

// Takes ownership of the text.
std::optional<std::string> taken(xmlChar* text) {
    if (text == nullptr) return std::nullopt;
    const std::unique_ptr<xmlChar, decltype(xmlFree)> owned(text, xmlFree);
    return std::string(view(text));
}

void ignoreText(void*, const char*, ...) {}

// Errors are told by results. The options of a reader alone do not keep libxml2 quiet.
void silence() { xmlSetGenericErrorFunc(nullptr, ignoreText); }

}  // namespace

PartReader::PartReader(Package& package, const std::string& name) : entry_(package, name) {
    silence();
    reader_.reset(xmlReaderForIO(supply, nullptr, this, nullptr, nullptr,
                                 XML_PARSE_NOERROR | XML_PARSE_NOWARNING | XML_PARSE_NONET));
    broken_ = reader_ == nullptr;
}

int PartReader::supply(void* self, char* buffer, int size) {
    auto& reader = *static_cast<PartReader*>(self);
    const int count = reader.entry_.read(buffer, static_cast<unsigned>(size));
    reader.supplied_ += std::max(count, 0);
    const auto isMark = [](char c) { return c == '=' || c == '-'; };
    reader.marks_ += std::count_if(buffer, buffer + std::max(count, 0), isMark);
    return reader.holdsTooMuch() ? -1 : count;
}

// libxml2 processes text as it arrives, but keeps markup until it is complete. Tags may be long
// because of lists of cell ranges; but only hostile markup has thousands of attributes, which
// libxml2 compares with each other, or of hyphens in a comment.
bool PartReader::holdsTooMuch() {
    constexpr long kLongMarkup = 16 << 10;      // bytes
    constexpr long kLongestMarkup = 256 << 10;  // bytes
    constexpr long kMostMarks = 4096;
    const long used = reader_ ? xmlTextReaderByteConsumed(reader_.get()) : supplied_;
    const long waiting = used < 0 ? 0 : supplied_ - used;
    if (waiting <= kLongMarkup) marks_ = 0;
    return waiting > kLongestMarkup || marks_ > kMostMarks;
}

bool PartReader::hasDeclarations() const {
    const xmlNode* node = xmlTextReaderCurrentNode(reader_.get());
    return node != nullptr && node->doc != nullptr && node->doc->intSubset != nullptr;
}

bool PartReader::next() {
    while (!broken_) {
        stopIfInterrupted();
        const int result = xmlTextReaderRead(reader_.get());
        broken_ = result < 0 || hasDeclarations();
        if (broken_ || result == 0) return false;
        const int type = xmlTextReaderNodeType(reader_.get());
        if (type == XML_READER_TYPE_ELEMENT || isText()) return true;
    }
    return false;
}

bool PartReader::nextElement() {
    while (next()) {
        if (!isText()) return true;
    }
    return false;
}

bool PartReader::isText() const {
    const int type = xmlTextReaderNodeType(reader_.get());
    return type == XML_READER_TYPE_TEXT || type == XML_READER_TYPE_SIGNIFICANT_WHITESPACE ||
           isCData();
}

bool PartReader::isCData() const {
    return xmlTextReaderNodeType(reader_.get()) == XML_READER_TYPE_CDATA;
}

std::string PartReader::text() const {
    return std::string(view(xmlTextReaderConstValue(reader_.get())));
}

std::string_view PartReader::element() const {
    const std::string_view space = view(xmlTextReaderConstNamespaceUri(reader_.get()));
    const bool ours =
        std::find(std::begin(kNamespaces), std::end(kNamespaces), space) != std::end(kNamespaces);
    return ours || !isPrefixed() ? view(xmlTextReaderConstLocalName(reader_.get()))
                                 : std::string_view();
}

bool PartReader::isPrefixed() const { return xmlTextReaderConstPrefix(reader_.get()) != nullptr; }

std::string PartReader::writtenName() const {
    return std::string(view(xmlTextReaderConstName(reader_.get())));
}

int PartReader::depth() const { return xmlTextReaderDepth(reader_.get()); }

std::optional<std::string> PartReader::attribute(const char* name) const {
    return taken(xmlTextReaderGetAttribute(reader_.get(), xml(name)));
}

std::optional<std::string> PartReader::relationshipId() const {
    for (const char* space : kRelationships) {
        auto id = taken(xmlTextReaderGetAttributeNs(reader_.get(), xml("id"), xml(space)));
        if (id) return id;
    }
    return attribute("r:id");
}

bool PartReader::hasWritten(const char* name) const { return attribute(name).has_value(); }

}  // namespace dp::tool
