#pragma once

#include <string>

namespace dp {

// Where an entry of a package goes, relative to the directory that it is unpacked into.
struct EntryName {
    std::string directory;  // empty for the directory itself
    std::string file;       // empty for an entry that is only a directory
};

// Splits the name of an entry into directory and file. A ".." removes the component before it, in
// the name alone: links are not followed. False for a name that leads out of the directory, even if
// it leads back: an absolute name, or one with a ".." that has no component to remove. All other
// characters, including colons and backslashes, are part of file names.
bool parseEntryName(const std::string& name, EntryName& entry);

}  // namespace dp
