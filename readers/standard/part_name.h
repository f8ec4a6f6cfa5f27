#pragma once

#include <string>
#include <string_view>

namespace dp::standard {

// Names of parts in one form: segments joined by "/" without one in front, "." and ".." resolved as
// in addresses (there is nothing above the root), percent escapes decoded, backslashes as slashes.

// The name of the part that a relationship of the part `source` leads to; those of the package have
// an empty source. Throws CmXmlException for a target of unreasonable length.
std::string resolvePartName(std::string_view source, std::string_view target);

// The part that holds the relationships of `source`.
std::string relationshipPartOf(std::string_view source);

// Two names that fold to the same text name the same part: the case of ASCII letters does not
// count.
std::string foldPartName(std::string_view name);

}  // namespace dp::standard
