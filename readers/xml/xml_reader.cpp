#include "dpxlsx/readers/xml/xml_reader.h"

#include <unistd.h>

#include <cstring>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "dpxlsx/readers/xml/file_copy.h"
#include "dpxlsx/readers/xml/known_names.h"
#include "dpxlsx/readers/xml/part_input.h"
#include "dpxlsx/readers/xml/progress.h"
#include "dpxlsx/readers/xml/silence.h"
#include "dpxlsx/readers/xml/temporary_path.h"

namespace {

// libxml2 takes a relative path that contains a scheme for an address, even on another machine, and
// cannot open a file with such a name; a copy under another name opens.
bool looksLikeAddress(const std::string& path) {
    return !path.starts_with('/') && path.find("://") != path.npos;
}

// Null for a path that cannot be opened, or that libxml2 would take for an address.
xmlTextReaderPtr openFile(const std::string& path) {
    return looksLikeAddress(path) ? nullptr : dp::openDocument(path);
}

// The path of a private copy of `path`; empty when it could not be made. Throws the file system's
// error when there is no temporary directory.
std::string copyToTemporary(const std::string& path) {
    std::string copy = dp::unusedTemporaryPath();
    if (!copy.empty() && !dp::copyFile(path, copy)) copy.clear();
    return copy;
}

// libxml2 composes a prefixed name when it is asked for, and fails to once the document has filled
// the dictionary of names. Skipping the element instead would lose its content.
void requireNoElement(int nodeType) {
    if (nodeType == XML_READER_TYPE_ELEMENT || nodeType == XML_READER_TYPE_END_ELEMENT)
        throw CmXmlException(kXmlError);
}

int moveOn(xmlTextReaderPtr reader) {
    const dp::DocumentMove move;
    return xmlTextReaderRead(reader);
}

bool isTooDeep(xmlTextReaderPtr reader) {
    return xmlTextReaderDepth(reader) >= dp::kXmlDepth &&
           xmlTextReaderNodeType(reader) == XML_READER_TYPE_ELEMENT;
}

}  // namespace

CmXmlException::CmXmlException(int code) : code_(code) {}

int CmXmlException::code() const { return code_; }

XmlReader::XmlReader() = default;

XmlReader::~XmlReader() {
    if (textReader) xmlFreeTextReader(textReader);
    textReader = nullptr;
    if (tempCopy) ::unlink(tempPath.c_str());
}

void XmlReader::mInitialize(const std::string& path) {
    const dp::SilentLibxml2 silent;
    textReader = openFile(path);
    if (!textReader) {
        tempPath = copyToTemporary(path);
        tempCopy = !tempPath.empty();
        if (tempCopy) textReader = openFile(tempPath);
    }
    if (!textReader || !readNode() || dp::declaresTooMuch(textReader))
        throw CmXmlException(kXmlError);
    dp::limitNames(textReader);
}

bool XmlReader::readNode() {
    const dp::SilentLibxml2 silent;
    const int result = moveOn(textReader);
    endOfFile = result == 0;
    if (result == -1 || isTooDeep(textReader)) throw CmXmlException(kXmlError);
    dp::Progress::tell();  // here, because no exception may pass through libxml2
    return !endOfFile;
}

bool XmlReader::readToElement() {
    while (readNode())
        if (nodeType() == XML_READER_TYPE_ELEMENT) return true;
    return false;
}

bool XmlReader::skipElement() {
    const bool closes =
        nodeType() == XML_READER_TYPE_ELEMENT && xmlTextReaderIsEmptyElement(textReader) != 1;
    const int depth = xmlTextReaderDepth(textReader);
    const auto isEnd = [this, depth] {
        return nodeType() == XML_READER_TYPE_END_ELEMENT && xmlTextReaderDepth(textReader) == depth;
    };
    while (closes && readNode() && !isEnd()) {
    }
    return !endOfFile && readNode();
}

bool XmlReader::mGotoElement(const char* name) {
    const auto isWanted = [this, name] {
        const char* current = nodeName();
        return current && std::strcmp(current, name) == 0;
    };
    while (!isWanted())
        if (!readToElement()) return false;
    return true;
}

bool XmlReader::moveToAttribute(const char* name) {
    const int result =
        xmlTextReaderMoveToAttribute(textReader, reinterpret_cast<const xmlChar*>(name));
    if (result == -1) throw CmXmlException(kXmlError);
    return result != 0;
}

template <class T>
bool XmlReader::mReadAttribute(T& value, const char* name) {
    if (!moveToAttribute(name)) return false;
    if (const char* text = nodeValue()) CmXmlCast::instance().mCast(value, text);
    return true;
}

template bool XmlReader::mReadAttribute<int>(int&, const char*);
template bool XmlReader::mReadAttribute<unsigned>(unsigned&, const char*);

bool XmlReader::mReadAttribute_NotSafe(int& value, const char* name) {
    return mReadAttribute(value, name);
}

std::string XmlReader::attributeText(const char* name) {
    const char* text = moveToAttribute(name) ? nodeValue() : nullptr;
    return text ? std::string(text) : std::string();
}

const char* XmlReader::knownName(const char* name) {
    const xmlChar* known =
        xmlTextReaderConstString(textReader, reinterpret_cast<const xmlChar*>(name));
    if (!known) throw CmXmlException(kXmlError);
    return reinterpret_cast<const char*>(known);
}

int XmlReader::nodeType() const { return xmlTextReaderNodeType(textReader); }

const char* XmlReader::nodeName() const {
    const xmlChar* name = xmlTextReaderConstName(textReader);
    if (!name) requireNoElement(nodeType());
    return reinterpret_cast<const char*>(name);
}

const char* XmlReader::nodeValue() const {
    return reinterpret_cast<const char*>(xmlTextReaderConstValue(textReader));
}

namespace dp::xml {

int mReadForElements(XmlReader& reader, const std::vector<std::string>& names) {
    return names.empty() ? -1 : readToOneOf(reader, KnownNames(reader, names));
}

}  // namespace dp::xml
