#pragma once

#include <string>

namespace dp {

// Copies a file to `target`, which must not exist yet and is the owner's alone, whatever the umask
// and the source's rights. False when anything could not be read or written; then nothing stays.
// Not Boost's own: that one fails between two file systems on kernels that copy ranges
// within one only.
bool copyFile(const std::string& source, const std::string& target);

}  // namespace dp
