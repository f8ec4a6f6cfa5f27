#pragma once

#include <string>

#include "tools/package/package.h"

namespace dp::tool {

enum class FileKind {
    Workbook,  // a package with a workbook inside, in whatever state
    PasswordProtected,
    OldWorkbook,
    OtherCompound,
    Spreadsheet2003,
    WebPage,
    PlainText,
    Empty,
    CutPackage,
    OpenDocument,
    TextDocument,
    Presentation,
    BinaryWorkbook,
    OtherArchive,
    Unknown
};

// The kind of the file by its content, whatever its name. `package` is the same file. Throws a
// Failure when the file cannot be read.
FileKind fileKind(const std::string& path, const Package& package);

}  // namespace dp::tool
