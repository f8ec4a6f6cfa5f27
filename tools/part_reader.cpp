#include "tools/part_reader.h"

#include <algorithm>
#include <string_view>

#include "tools/interrupt.h"

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

// Takes the text over.
std::optional<std::string> taken(xmlChar* text) {
    if (text == nullptr) return std::nullopt;
    const std::unique_ptr<xmlChar, decltype(xmlFree)> owned(text, xmlFree);
    return std::string(view(text));
}

int readEntry(void* entry, char* buffer, int size) {
    return static_cast<Entry*>(entry)->read(buffer, static_cast<unsigned>(size));
}

}  // namespace

PartReader::PartReader(Package& package, const std::string& name)
    : entry_(package, name),
      reader_(xmlReaderForIO(readEntry, nullptr, &entry_, nullptr, nullptr,
                             XML_PARSE_NOERROR | XML_PARSE_NOWARNING | XML_PARSE_NONET)),
      broken_(reader_ == nullptr) {}

bool PartReader::next() {
    while (!broken_) {
        stopIfInterrupted();
        const int result = xmlTextReaderRead(reader_.get());
        broken_ = result < 0;
        if (result <= 0) return false;
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
    return xmlTextReaderNodeType(reader_.get()) == XML_READER_TYPE_TEXT;
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
