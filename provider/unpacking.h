#pragma once

#include <string>

#include "dpxlsx/provider/package.h"

namespace dp {

// Unpacks the archive at `archive` into `directory`, an absolute path that exists. Entries are
// streamed; nothing outside the directory is written, and the archive itself is not overwritten.
// What was written stays there after a failure. A package that claims more bytes or entries than
// the limits or the free space allow is refused before anything is written.
PackageStatus unpackArchive(const std::string& archive, const std::string& directory);

}  // namespace dp
