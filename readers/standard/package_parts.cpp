#include "dpxlsx/readers/standard/package_parts.h"

#include <algorithm>
#include <cstddef>

#include <boost/filesystem.hpp>

#include "dpxlsx/readers/standard/element_walker.h"
#include "dpxlsx/readers/standard/part_name.h"

namespace dp::standard {

namespace {

namespace fs = boost::filesystem;

constexpr const char* kUsualWorkbook = "xl/workbook.xml";

std::string lastSegment(const std::string& type) { return type.substr(type.rfind('/') + 1); }

}  // namespace

PackageParts::PackageParts(const std::string& directory) {
    // Not by Boost's lexically_relative, which ends the process when memory runs out.
    const std::size_t prefix = directory.size() + (directory.ends_with('/') ? 0 : 1);
    std::vector<std::string> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(directory))
        if (fs::is_regular_file(entry.path()))
            files.push_back(entry.path().native().substr(prefix));
    std::sort(files.begin(), files.end());  // directories are listed in any order
    for (const std::string& file : files) {
        const std::string name = resolvePartName({}, file);
        std::string path = directory;
        path.append("/").append(file);
        pathByName_.try_emplace(name, path);
        pathByFoldedName_.try_emplace(foldPartName(name), path);
    }
}

std::string PackageParts::pathOf(const std::string& partName) const {
    if (const auto exact = pathByName_.find(partName); exact != pathByName_.end())
        return exact->second;
    const auto folded = pathByFoldedName_.find(foldPartName(partName));
    return folded == pathByFoldedName_.end() ? std::string() : folded->second;
}

std::vector<Relationship> PackageParts::relationshipsOf(std::string_view source) const {
    std::vector<Relationship> relationships;
    ElementWalker walker(pathOf(relationshipPartOf(source)), Vocabulary::Package);
    walker.children([&](std::string_view name) {
        if (name != "Relationship" || walker.attribute("TargetMode") == "External") return;
        const std::string target = walker.attribute("Target").value_or("");
        if (target.empty()) return;  // would lead to the folder of the source
        relationships.push_back({walker.attribute("Id").value_or(""),
                                 lastSegment(walker.attribute("Type").value_or("")),
                                 resolvePartName(source, target)});
    });
    walker.finish();
    return relationships;
}

std::string PackageParts::pathByType(const std::vector<Relationship>& relationships,
                                     std::string_view type, std::string_view source) const {
    const auto found = std::find_if(relationships.begin(), relationships.end(),
                                    [type](const Relationship& r) { return r.type == type; });
    if (found != relationships.end()) return pathOf(found->part);
    return pathOf(resolvePartName(source, std::string(type) + ".xml"));
}

std::string PackageParts::workbookPart() const {
    if (!pathOf(relationshipPartOf({})).empty())
        for (const Relationship& relationship : relationshipsOf({}))
            if (relationship.type == "officeDocument" && !pathOf(relationship.part).empty())
                return relationship.part;
    return pathOf(kUsualWorkbook).empty() ? std::string() : kUsualWorkbook;
}

}  // namespace dp::standard
