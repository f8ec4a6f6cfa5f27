#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace dp::standard {

struct Relationship {
    std::string id;
    std::string type;  // the last segment of the type's name, as "worksheet"
    std::string part;  // the name of the part that it leads to
};

// The parts of an unpacked package, by their names and relationships.
class PackageParts {
  public:
    // Lists the files in `directory`. Throws the file system's error.
    explicit PackageParts(const std::string& directory);

    // The path of a part's file, empty when the package has no such part. A part of exactly this
    // name goes before others that fold to it.
    std::string pathOf(const std::string& partName) const;

    // The relationships of the part `source`, the package's own for an empty name; those that lead
    // out of the package are left out. Throws CmXmlException, also when the part has none.
    std::vector<Relationship> relationshipsOf(std::string_view source) const;

    // The path of the one part of this type that `source` has: where the first of its
    // relationships of the type leads, or without one the usual place beside `source`. Empty when
    // there is no such part.
    std::string pathByType(const std::vector<Relationship>& relationships, std::string_view type,
                           std::string_view source) const;

    // The name of the workbook part: where the package's office-document relationship leads, or the
    // usual place in a package without such a relationship. Empty when there is none.
    std::string workbookPart() const;

  private:
    // Ordered: hashes could be made to collide.
    std::map<std::string, std::string> pathByName_;
    std::map<std::string, std::string> pathByFoldedName_;
};

}  // namespace dp::standard
