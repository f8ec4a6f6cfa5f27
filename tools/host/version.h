#pragma once

#include <string>

namespace dp::tool {

// The versions of the program, of the import library that would be loaded (`library` as for
// Library), and of what both are built on: as the loaded libraries tell or, of those that do not,
// as their files are named.
std::string versionText(const std::string& library);

}  // namespace dp::tool
