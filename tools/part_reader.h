#pragma once

#include <memory>
#include <optional>
#include <string>

#include <libxml/xmlreader.h>

#include "tools/package.h"

namespace dp::tool {

// Walks the elements of an XML part of a spreadsheet package, forward and in little memory: a part
// with a document type or with markup that only a hostile one has counts as broken there.
// Elements go by their local names within the namespaces of spreadsheets, whatever their prefix,
// and by their names alone when they have no prefix.
class PartReader {
  public:
    PartReader(Package& package, const std::string& name);

    // Moves to the next node that is the beginning of an element, or a text. False at the end of
    // the part and where it breaks off. Throws Interrupted after an interrupt.
    bool next();
    // Skips texts.
    bool nextElement();

    // White space between elements is a text too.
    bool isText() const;
    // Whether the text is written as a CDATA section.
    bool isCData() const;
    // The text node's content.
    std::string text() const;

    // The element's local name; empty for an element of a foreign namespace.
    std::string_view element() const;
    // Whether the element's name has a prefix: an import that goes by the names as they are written
    // does not know it.
    bool isPrefixed() const;
    // As written, prefix included.
    std::string writtenName() const;
    // 0 for the root.
    int depth() const;
    // The attribute of this name without a namespace, if there is one.
    std::optional<std::string> attribute(const char* name) const;
    // The attribute `id` of the namespace of relationships, whatever its prefix.
    std::optional<std::string> relationshipId() const;
    // Whether the attribute has exactly this written name, prefix included.
    bool hasWritten(const char* name) const;

    // Whether the part is missing, malformed or damaged, as far as it has been read.
    bool isBroken() const { return broken_; }

  private:
    struct Free {
        void operator()(xmlTextReaderPtr reader) const { xmlFreeTextReader(reader); }
    };

    static int supply(void* self, char* buffer, int size);
    bool holdsTooMuch();
    bool hasDeclarations() const;

    Entry entry_;        // outlives the reader, which draws from it
    long supplied_ = 0;  // bytes
    long marks_ = 0;     // equal signs and hyphens in long markup that waits to be complete
    std::unique_ptr<xmlTextReader, Free> reader_;
    bool broken_ = false;
};

}  // namespace dp::tool
