#include "dpxlsx/readers/standard/element_walker.h"

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/attributes.h"

namespace dp::standard {

namespace {

const char* characters(const xmlChar* text) { return reinterpret_cast<const char*>(text); }

const char* namespaceName(const xmlNs* space) { return space ? characters(space->href) : nullptr; }

const xmlNode& currentNode(const XmlReader& reader) {
    const xmlNode* node = xmlTextReaderCurrentNode(reader.textReader);
    if (!node || !node->name) throw CmXmlException(kXmlError);
    return *node;
}

}  // namespace

ElementWalker::ElementWalker(const std::string& path, Vocabulary vocabulary)
    : vocabulary_(vocabulary) {
    reader_.mInitialize(path);
    while (!atBegin()) read();
}

std::string_view ElementWalker::name() const { return characters(currentNode(reader_).name); }

bool ElementWalker::is(std::string_view localName) const {
    return atBegin() && isSeen() && name() == localName;
}

std::optional<std::string> ElementWalker::attribute(std::string_view localName,
                                                    Vocabulary vocabulary) {
    Attributes attributes(reader_);
    for (const xmlAttr* a = attributes.first(); a; a = a->next)
        if (characters(a->name) == localName && vocabularyOf(namespaceName(a->ns)) == vocabulary)
            return attributes.valueOf(a);
    return std::nullopt;
}

std::string ElementWalker::text() {
    std::string joined;
    if (!atBegin() || isEmptyElement()) return joined;
    const int depth = currentDepth();
    for (read(); currentDepth() > depth; read()) {
        const int type = reader_.nodeType();
        if (type == XML_READER_TYPE_ELEMENT) {
            skip();
        } else if (type == XML_READER_TYPE_TEXT || type == XML_READER_TYPE_CDATA ||
                   type == XML_READER_TYPE_SIGNIFICANT_WHITESPACE ||
                   type == XML_READER_TYPE_WHITESPACE) {
            if (const char* value = reader_.nodeValue()) joined += value;
            if (joined.size() > kRunSize) throw CmXmlException(kXmlError);
        }
    }
    return joined;
}

void ElementWalker::finish() {
    while (reader_.readNode()) {
    }
}

int ElementWalker::currentDepth() const { return xmlTextReaderDepth(reader_.textReader); }

Vocabulary ElementWalker::currentVocabulary() const {
    return vocabularyOf(namespaceName(currentNode(reader_).ns));
}

bool ElementWalker::isSeen() const {
    const Vocabulary vocabulary = currentVocabulary();
    return vocabulary == vocabulary_ || vocabulary == Vocabulary::None;
}

// The content of such an element counts as that of its parent.
bool ElementWalker::isTransparent() const {
    return currentVocabulary() == Vocabulary::Compatibility &&
           (name() == "AlternateContent" || name() == "Fallback");
}

// Moves to the next child, or to the end of the parent.
bool ElementWalker::nextChild(int parentDepth) {
    if (currentDepth() == parentDepth && (!atBegin() || isEmptyElement())) return false;
    for (read(); currentDepth() > parentDepth; read()) {
        if (!atBegin()) continue;
        if (isSeen()) return true;
        if (!isTransparent()) skip();
    }
    return false;
}

bool ElementWalker::atBegin() const { return reader_.nodeType() == XML_READER_TYPE_ELEMENT; }

bool ElementWalker::isEmptyElement() const {
    return xmlTextReaderIsEmptyElement(reader_.textReader) == 1;
}

void ElementWalker::read() {
    if (!reader_.readNode()) throw CmXmlException(kXmlError);
}

// Moves to the end of the current element, unless the walker is there already.
void ElementWalker::skip() {
    if (!atBegin() || isEmptyElement()) return;
    const int depth = currentDepth();
    do read();
    while (currentDepth() > depth);
}

}  // namespace dp::standard
