#pragma once

#include <string>

namespace dp {

// Copies a file to `target`, which must not exist yet; only its owner can access it, whatever the
// umask and the source's permissions. False when anything could not be read or written; then no
// target is left. Not Boost's copy_file, which fails across file systems on kernels whose
// copy_file_range works within one file system only.
bool copyFile(const std::string& source, const std::string& target);

}  // namespace dp
