#pragma once

#include <string>

namespace dp {

// Where an entry of a package goes, relative to the directory that it is unpacked into.
struct EntryName {
    std::string directory;  // empty for the directory itself
    std::string file;       // empty for an entry that is only a directory
};

// Takes the name of an entry apart. False for a name that leads out of the directory: an absolute
// one, one with a drive letter, or one with a ".." component.
bool parseEntryName(const std::string& name, EntryName& entry);

}  // namespace dp
