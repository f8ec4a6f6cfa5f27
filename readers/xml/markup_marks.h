#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace dp {

// Equal signs and hyphens: an element has at least one of them for each attribute, a comment for
// each error in it.
constexpr bool isMarkupMark(char c) { return c == '=' || c == '-'; }

// Counts them in a document that is passed to it from the first byte on, except those in CDATA
// sections, which are text. Follows the markup as long as it is well-formed; a parser gets no
// further. Only for UTF-8.
class MarkupMarks {
  public:
    // Counts in the document's next bytes.
    std::size_t countIn(std::string_view bytes);

  private:
    // Markup that ends at its closing, whatever is in between.
    struct Enclosed {
        std::string_view opening;  // behind the "<"
        std::string_view closing;
    };
    static constexpr Enclosed kComment{"!--", "-->"};
    static constexpr Enclosed kSection{"![CDATA[", "]]>"};
    static constexpr Enclosed kInstruction{"?", "?>"};

    void take(char c);
    void takeInTag(char c);
    bool endsWith(std::string_view text) const;

    const Enclosed* enclosed_ = nullptr;  // that contains the last byte, if any
    bool inTag_ = false;                  // also in a declaration
    char quote_ = '\0';                   // of the attribute's value, in a tag
    std::uint64_t last_ = 0;              // the last 8 bytes
    std::size_t length_ = 0;              // bytes since the last "<"
};

}  // namespace dp
