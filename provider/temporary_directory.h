#pragma once

#include <cstdint>
#include <string>

#include "dpxlsx/model/host/export.h"

namespace dp {

// Makes a directory of its own under the system's temporary directory, readable by its owner only
// whatever the umask. Returns its absolute path, empty when it cannot be made. Throws the file
// system's error when there is no temporary directory.
std::string makePrivateDirectory();

// Makes one directory that its owner alone may use, whatever the umask. False when it cannot be
// made.
bool makeOwnDirectory(const std::string& path);

// Bytes that this process may still write into a directory; the largest number if the file system
// does not say.
std::uint64_t freeSpace(const std::string& directory);

// Removes a directory with everything below it; a path that names no directory is left alone, and
// what cannot be removed stays.
DPXLSX_API void removeDirectoryAndContents(const std::string& path);

}  // namespace dp
