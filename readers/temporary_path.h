#pragma once

#include <string>

namespace dp {

// An absolute path below the system's temporary directory, of a random name that nothing there has
// yet; empty when no name can be made. Throws the file system's error when there is no temporary
// directory, or when it is relative to a working directory that is gone.
std::string unusedTemporaryPath();

}  // namespace dp
