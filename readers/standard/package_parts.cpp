#include "dpxlsx/readers/standard/package_parts.h"

#include <dirent.h>

#include <algorithm>
#include <cerrno>
#include <memory>
#include <sys/stat.h>
#include <utility>

#include <boost/filesystem.hpp>

#include "dpxlsx/readers/standard/element_walker.h"
#include "dpxlsx/readers/standard/part_name.h"

namespace dp::standard {

namespace {

constexpr const char* kUsualWorkbook = "xl/workbook.xml";

[[noreturn]] void throwError(const std::string& path) {
    throw boost::filesystem::filesystem_error("cannot list the parts", path,
                                              {errno, boost::system::system_category()});
}

// The paths of all files below the directory, relative to it. Not by Boost's iterator (1.83) nor by
// that of the standard library (g++ 12), which end the process when memory runs out.
std::vector<std::string> listFiles(const std::string& directory) {
    const std::string root = directory.ends_with('/') ? directory : directory + '/';
    std::vector<std::string> files;
    std::vector<std::string> folders = {""};
    while (!folders.empty()) {
        const std::string folder = std::move(folders.back());
        folders.pop_back();
        const std::unique_ptr<DIR, int (*)(DIR*)> list(::opendir((root + folder).c_str()),
                                                       ::closedir);
        if (!list) throwError(root + folder);
        for (;;) {
            errno = 0;
            const dirent* entry = ::readdir(list.get());
            if (entry == nullptr && errno == 0) break;
            if (entry == nullptr) throwError(root + folder);
            const std::string_view name = entry->d_name;
            if (name == "." || name == "..") continue;
            std::string path = folder;
            path.append(name);
            struct stat status {};
            if (::stat((root + path).c_str(), &status) != 0) throwError(root + path);
            if (S_ISDIR(status.st_mode)) folders.push_back(path + '/');
            if (S_ISREG(status.st_mode)) files.push_back(std::move(path));
        }
    }
    return files;
}

std::string lastSegment(const std::string& type) { return type.substr(type.rfind('/') + 1); }

}  // namespace

PackageParts::PackageParts(const std::string& directory) {
    std::vector<std::string> files = listFiles(directory);
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
