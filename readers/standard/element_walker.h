#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "dpxlsx/readers/standard/vocabulary.h"
#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp::standard {

// Walks a part by its elements, once and forward. It sees the elements of one vocabulary and those
// without a namespace, whatever their prefixes; elements of others are skipped with all they hold.
// In the place of alternatives for other programs it sees the fallback. All limits of XmlReader
// hold; every operation that moves throws CmXmlException.
class ElementWalker {
  public:
    // Opens the part and moves to its root.
    explicit ElementWalker(const std::string& path,
                           Vocabulary vocabulary = Vocabulary::Spreadsheet);

    // The name of the current element without its prefix; valid until the walker leaves the
    // element.
    std::string_view name() const;
    // Whether the current element, which may be the root, has this name in the vocabulary.
    bool is(std::string_view localName) const;

    // An attribute of the current element before its content is read.
    std::optional<std::string> attribute(std::string_view localName,
                                         Vocabulary vocabulary = Vocabulary::None);

    // Calls `visit(name)` for each child of the current element, which for the call's duration is
    // the current one. What `visit` does not read is skipped.
    template <class Visit>
    void children(const Visit& visit) {
        const int depth = currentDepth();
        while (nextChild(depth)) {
            visit(name());
            skip();
        }
    }
    // All characters of the current element, those of elements within it left out.
    std::string text();
    // Reads what is left of the part, which says nothing but may be damaged.
    void finish();

  private:
    int currentDepth() const;
    Vocabulary currentVocabulary() const;
    bool isSeen() const;
    bool isTransparent() const;
    bool nextChild(int parentDepth);
    bool atBegin() const;
    bool isEmptyElement() const;
    void read();
    void skip();

    XmlReader reader_;
    const Vocabulary vocabulary_;
};

}  // namespace dp::standard
