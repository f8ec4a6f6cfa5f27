#include "dpxlsx/provider/entry_name.h"

#include <cstddef>
#include <string_view>

namespace dp {

namespace {

// Removes the last component; false when there is none.
bool goUp(std::string& directory) {
    if (directory.empty()) return false;
    const std::size_t slash = directory.rfind('/');
    directory.resize(slash == directory.npos ? 0 : slash);
    return true;
}

void goDown(std::string& directory, std::string_view component) {
    if (!directory.empty()) directory += '/';
    directory += component;
}

}  // namespace

bool parseEntryName(const std::string& name, EntryName& entry) {
    entry = {};
    if (name.starts_with('/')) return false;
    std::string_view rest = name;
    while (true) {
        const std::size_t slash = rest.find('/');
        const bool isLast = slash == rest.npos;
        const std::string_view component = rest.substr(0, slash);
        if (component == "..") {
            if (!goUp(entry.directory)) return false;
        } else if (!component.empty() && component != ".") {
            if (isLast)
                entry.file = component;
            else
                goDown(entry.directory, component);
        }
        if (isLast) return true;
        rest.remove_prefix(slash + 1);
    }
}

}  // namespace dp
