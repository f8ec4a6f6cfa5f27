#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace dp {

// Reads the workbook's relationships to worksheets, ids and targets at the same index. Both lists
// start with 10 entries and grow by doubling; unused entries at their ends are kept. Throws
// CmXmlException.
void mReadWorkbookRelationships(const std::string& xlDir, std::vector<std::string>& ids,
                                std::vector<std::string>& targets);

// Finds the first entry of a list of ids. The list must not change during the index's lifetime.
class RelationshipIndex {
  public:
    RelationshipIndex() = default;
    explicit RelationshipIndex(const std::vector<std::string>& ids);

    // The entry's index, or -1.
    std::ptrdiff_t find(const std::string& id) const;

  private:
    std::map<std::string_view, std::size_t> firstById_;  // ordered: hashes could be made to collide
};

// The path of the part that the workbook's relationship target names, "." and ".." resolved within
// the package directory `dir`; a target that starts with a slash is taken from the package's root,
// others from its xl folder. Throws CmXmlException for a target that leaves the package or is too
// long.
std::string resolveTarget(const std::string& dir, const std::string& target);

}  // namespace dp
