#pragma once

#include <string>

#include "dpxlsx/store/reading_rules.h"

namespace dp {

// How a step of opening ended.
enum class PackageStatus : int {
    Success = 0,
    SourceMissing = 3,      // no such file, or not a regular one
    EntryError = 5,         // an entry cannot be read, written or checked
    TooLarge = 6,           // beyond a limit
    NotAPackage = 7,        // another extension, or not a ZIP archive
    DirectoryUnusable = 9,  // the temporary directory, or the copy in it, cannot be made
    ArchiveNotClosed = 10,
    NotAWorkbook = 13,  // no style sheet or workbook part, or the latter is not XML
    Cancelled = 20      // by the host, when it was told of the progress
};

// The result code that the host gets.
long resultCode(PackageStatus status);

// Whether the unpacked package in `directory` is a workbook by these rules. Throws the file
// system's error when its parts cannot be looked up.
PackageStatus checkWorkbook(const std::string& directory, ReadingRules rules);

}  // namespace dp
