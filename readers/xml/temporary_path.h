#pragma once

#include <string>

namespace dp {

// An absolute path below the system's temporary directory, with a random name: whoever creates it
// fails if it exists. Empty when no name can be made. Throws the file system's error when there is
// no temporary directory, or when it is relative to a working directory that is gone.
std::string unusedTemporaryPath();

}  // namespace dp
