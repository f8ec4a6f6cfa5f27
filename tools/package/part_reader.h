#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include <libxml/xmlreader.h>

#include "tools/package/package.h"

namespace dp::tool {

// Walks the elements of an XML part of a spreadsheet package, forward and in little memory. A
// document type, or markup that only hostile parts have, counts as damage. Elements are identified
// by their local names: those with a prefix only if they belong to the namespaces of spreadsheets,
// those without a prefix in any namespace.
class PartReader {
  public:
    PartReader(Package& package, const std::string& name);

    // Moves to the next start of an element or text node. False at the end of the part and at
    // damage. Throws Interrupted after an interrupt.
    bool next();
    // Like next(), but skips texts.
    bool nextElement();

    // White space between elements is a text too.
    bool isText() const;
    // Whether the text is written as a CDATA section.
    bool isCData() const;
    // The text node's content.
    std::string text() const;

    // The element's local name; empty for an element of a foreign namespace.
    std::string_view element() const;
    // Whether the element's name has a prefix: the import library compares whole names and does not
    // recognise such an element.
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

    Entry entry_;        // read by the XML reader, so it must outlive that
    long supplied_ = 0;  // bytes
    long marks_ = 0;     // equal signs and hyphens in long markup that is not complete yet
    std::unique_ptr<xmlTextReader, Free> reader_;
    bool broken_ = false;
};

}  // namespace dp::tool
