#include "dpxlsx/provider/file_type.h"

#include <algorithm>
#include <cctype>

#include <boost/filesystem/path.hpp>

namespace dp {

bool hasXlsxExtension(const std::string& path) {
    std::string extension = boost::filesystem::path(path).extension().string();
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return extension == ".xlsx";
}

}  // namespace dp
