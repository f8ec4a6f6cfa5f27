#pragma once

#include <string>

namespace dp {

// Where an entry of a package goes, relative to the directory that it is unpacked into.
struct EntryName {
    std::string directory;  // empty for the directory itself
    std::string file;       // empty for an entry that is only a directory
};

// Takes the name of an entry apart. A ".." takes the component before it away, by the name alone: a
// link in its place is not followed. False for a name that leads out of the directory, be it to
// come back: an absolute one, or one with a ".." that has no component left. All other characters,
// colons and backslashes among them, are those of a file's name.
bool parseEntryName(const std::string& name, EntryName& entry);

}  // namespace dp
