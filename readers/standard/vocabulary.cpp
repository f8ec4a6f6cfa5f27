#include "dpxlsx/readers/standard/vocabulary.h"

#include <algorithm>
#include <iterator>
#include <string_view>

namespace dp::standard {

namespace {

struct Namespace {
    std::string_view name;
    Vocabulary vocabulary;
};

// The most frequent ones first.
constexpr Namespace kNamespaces[] = {
    {"http://schemas.openxmlformats.org/spreadsheetml/2006/main", Vocabulary::Spreadsheet},
    {"http://purl.oclc.org/ooxml/spreadsheetml/main", Vocabulary::Spreadsheet},
    {"http://schemas.openxmlformats.org/officeDocument/2006/relationships",
     Vocabulary::Relationships},
    {"http://purl.oclc.org/ooxml/officeDocument/relationships", Vocabulary::Relationships},
    {"http://schemas.openxmlformats.org/package/2006/relationships", Vocabulary::Package},
    {"http://schemas.openxmlformats.org/package/2006/content-types", Vocabulary::Package},
    {"http://schemas.openxmlformats.org/markup-compatibility/2006", Vocabulary::Compatibility},
};

}  // namespace

Vocabulary vocabularyOf(const char* namespaceName) {
    if (!namespaceName) return Vocabulary::None;
    const auto* known = std::find_if(
        std::begin(kNamespaces), std::end(kNamespaces),
        [name = std::string_view(namespaceName)](const Namespace& n) { return n.name == name; });
    return known == std::end(kNamespaces) ? Vocabulary::Foreign : known->vocabulary;
}

}  // namespace dp::standard
