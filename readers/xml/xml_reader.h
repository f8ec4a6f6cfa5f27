#pragma once

#include <string>
#include <vector>

#include "dpxlsx/model/host/export.h"

struct _xmlTextReader;  // libxml2's own name; NOLINT(bugprone-reserved-identifier)

// The one exception of the readers: an XML part that cannot be opened, read or understood. Carries
// no text; what failed is in the package, and the host shows its own message.
class DPXLSX_API CmXmlException {
  public:
    explicit CmXmlException(int code);

    int code() const;

  private:
    int code_;
};

// The code of every CmXmlException that the readers throw.
inline constexpr int kXmlError = 13;

// Reads one XML document forward, node by node. There is no way back: what must be read twice is
// opened twice. The network, external entities and entity substitution stay off. Nothing is
// printed, and the host's error handlers for libxml2 learn of nothing, except from calls that the
// host itself makes on `textReader`.
class DPXLSX_API XmlReader {
  public:
    XmlReader();
    XmlReader(const XmlReader&) = delete;
    XmlReader& operator=(const XmlReader&) = delete;
    ~XmlReader();

    // Opens the document and moves to its first node; to be called once, before all else. A file
    // that libxml2 cannot open under its own name is read from a private copy. Throws
    // CmXmlException when the file cannot be opened, is empty, or begins with an error.
    void mInitialize(const std::string& path);

    // Moves forward to the next element called `name`, staying where it is when the current node,
    // of any kind, has that name. False at the end of the document. Throws CmXmlException.
    bool mGotoElement(const char* name);

    // Reads an integer attribute of the current element; T is int or unsigned. True when the
    // attribute exists; text that does not start with a number leaves `value` as it was, and a
    // number too large for T becomes the largest one. Leaves the cursor on the attribute; the next
    // read continues behind the element. Throws CmXmlException.
    template <class T>
    bool mReadAttribute(T& value, const char* name);
    // The same as mReadAttribute for an int; the name says nothing about safety here.
    bool mReadAttribute_NotSafe(int& value, const char* name);

    // Moves to the next node; false at the end of the document. Throws CmXmlException.
    bool readNode();
    // Moves to the next element; false at the end of the document. Throws CmXmlException.
    bool readToElement();
    // Moves to the node behind the current element and its content; false at the end of the
    // document. Throws CmXmlException.
    bool skipElement();
    // The text of an attribute of the current element, empty when it has none. Moves the cursor as
    // mReadAttribute does. Throws CmXmlException.
    std::string attributeText(const char* name);
    // The document's own copy of `name`: the current node has this name if nodeName() returns the
    // same pointer. Only names with a prefix have other copies. Valid as long as the reader. Throws
    // CmXmlException when the document can keep no more names.
    const char* knownName(const char* name);
    // The current node's type and name as libxml2 gives them; the name may be null where the node
    // is no element. Throws CmXmlException for an element without one.
    int nodeType() const;
    const char* nodeName() const;
    // The current node's value, null when its kind has none. Valid until the next read.
    const char* nodeValue() const;

    bool tempCopy = false;   // the document is a private copy, which the destructor removes
    bool endOfFile = false;  // the last forward read came to the end of the document
    std::string tempPath;
    _xmlTextReader* textReader = nullptr;

  private:
    bool moveToAttribute(const char* name);
};

namespace dp::xml {

// Moves to the next element whose name is in `names` and returns the name's index; stays where it
// is when the current element is one. -1 at the end of the document and for an empty list. Throws
// CmXmlException.
DPXLSX_API int mReadForElements(XmlReader& reader, const std::vector<std::string>& names);

}  // namespace dp::xml
