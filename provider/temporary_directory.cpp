#include "provider/temporary_directory.h"

#include <unistd.h>

#include <sys/stat.h>

#include <boost/filesystem.hpp>

namespace dp {

namespace fs = boost::filesystem;

std::string makePrivateDirectory() {
    boost::system::error_code error;
    // Absolute, because the host may change its working directory before the file is closed.
    const fs::path directory =
        fs::absolute(fs::temp_directory_path()) / fs::unique_path("%%%%-%%%%", error);
    if (error) return {};
    return makeOwnDirectory(directory.string()) ? directory.string() : std::string();
}

bool makeOwnDirectory(const std::string& path) {
    // Closed to others from its first moment; the second call undoes what the umask took away.
    if (::mkdir(path.c_str(), S_IRWXU) != 0) return false;
    if (::chmod(path.c_str(), S_IRWXU) == 0) return true;
    ::rmdir(path.c_str());
    return false;
}

void removeDirectoryAndContents(const std::string& path) {
    boost::system::error_code ignored;
    if (!path.empty() && fs::is_directory(path, ignored)) fs::remove_all(path, ignored);
}

}  // namespace dp
