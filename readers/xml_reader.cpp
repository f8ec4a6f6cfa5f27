#include "readers/xml_reader.h"

#include <unistd.h>

#include <algorithm>
#include <cstring>
#include <string_view>

#include <boost/filesystem.hpp>
#include <libxml/xmlreader.h>

#include "readers/cm_xml_cast.h"
#include "readers/file_copy.h"
#include "readers/part_input.h"
#include "readers/silence.h"

namespace {

namespace fs = boost::filesystem;

// libxml2 takes a path with a scheme for the address of another file, on another machine even: no
// file opens under such a name, but a copy of it does.
bool looksLikeAddress(const std::string& path) { return path.find("://") != path.npos; }

// Null for a path that cannot be opened, or that names something else to libxml2.
xmlTextReaderPtr openFile(const std::string& path, const std::uint64_t& moves) {
    return looksLikeAddress(path) ? nullptr : dp::openDocument(path, moves);
}

// The path of a private copy of `path`; empty when it could not be made. Throws the file system's
// error when there is no temporary directory.
std::string copyToTemporary(const std::string& path) {
    boost::system::error_code error;
    std::string copy = (fs::temp_directory_path() / fs::unique_path("%%%%-%%%%", error)).string();
    if (!error && dp::copyFile(path, copy)) return copy;
    return {};
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
    textReader = openFile(path, moves_);
    if (!textReader) {
        tempPath = copyToTemporary(path);
        tempCopy = !tempPath.empty();
        if (tempCopy) textReader = openFile(tempPath, moves_);
    }
    if (!textReader || !readNode() || dp::declaresTooMuch(textReader))
        throw CmXmlException(kXmlError);
}

bool XmlReader::readNode() {
    ++moves_;
    const int result = xmlTextReaderRead(textReader);
    ++moves_;
    endOfFile = result == 0;
    if (result == -1) throw CmXmlException(kXmlError);
    return !endOfFile;
}

bool XmlReader::readToElement() {
    while (readNode())
        if (nodeType() == XML_READER_TYPE_ELEMENT) return true;
    return false;
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

int XmlReader::nodeType() const { return xmlTextReaderNodeType(textReader); }

const char* XmlReader::nodeName() const {
    return reinterpret_cast<const char*>(xmlTextReaderConstName(textReader));
}

const char* XmlReader::nodeValue() const {
    return reinterpret_cast<const char*>(xmlTextReaderConstValue(textReader));
}

namespace dp::xml {

int mReadForElements(XmlReader& reader, const std::vector<std::string>& names) {
    if (names.empty()) return -1;
    bool onElement = reader.nodeType() == XML_READER_TYPE_ELEMENT || reader.readToElement();
    for (; onElement; onElement = reader.readToElement()) {
        const std::string_view name = reader.nodeName();
        const auto found = std::find(names.begin(), names.end(), name);
        if (found != names.end()) return static_cast<int>(found - names.begin());
    }
    return -1;
}

}  // namespace dp::xml
