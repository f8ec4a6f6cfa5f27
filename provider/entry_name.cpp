#include "provider/entry_name.h"

#include <cctype>
#include <string_view>

namespace dp {

namespace {

bool hasDriveLetter(std::string_view name) {
    return name.size() >= 2 && name[1] == ':' &&
           std::isalpha(static_cast<unsigned char>(name[0])) != 0;
}

}  // namespace

bool parseEntryName(const std::string& name, EntryName& entry) {
    entry = {};
    if (name.starts_with('/') || hasDriveLetter(name)) return false;
    std::string_view rest = name;
    while (true) {
        const std::size_t slash = rest.find('/');
        const std::string_view component = rest.substr(0, slash);
        if (component == "..") return false;
        const bool named = !component.empty() && component != ".";
        if (slash == rest.npos) {
            if (named) entry.file = component;
            return true;
        }
        if (named) {
            if (!entry.directory.empty()) entry.directory += '/';
            entry.directory += component;
        }
        rest.remove_prefix(slash + 1);
    }
}

}  // namespace dp
