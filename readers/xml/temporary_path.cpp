#include "dpxlsx/readers/xml/temporary_path.h"

#include <boost/filesystem.hpp>

namespace dp {

std::string unusedTemporaryPath() {
    namespace fs = boost::filesystem;
    // Absolute, because the host may change its working directory before the path is done with. It
    // may have removed that directory too, which matters to relative paths alone.
    fs::path directory = fs::temp_directory_path();
    if (!directory.native().starts_with('/')) directory = fs::absolute(directory);
    boost::system::error_code error;
    const fs::path name = fs::unique_path("%%%%-%%%%", error);
    return error ? std::string() : (directory / name).string();
}

}  // namespace dp
