#include "provider/temporary_directory.h"

#include <sys/stat.h>

#include <boost/filesystem.hpp>

namespace dp {

namespace fs = boost::filesystem;

std::string makePrivateDirectory() {
    boost::system::error_code error;
    const fs::path model = fs::temp_directory_path() / "%%%%-%%%%";
    const fs::path directory = fs::unique_path(model, error);
    if (error) return {};
    // Closed to others from its first moment; the second call undoes what the umask took away.
    if (::mkdir(directory.c_str(), S_IRWXU) != 0) return {};
    if (::chmod(directory.c_str(), S_IRWXU) != 0) {
        fs::remove(directory, error);
        return {};
    }
    return directory.string();
}

void removeDirectoryAndContents(const std::string& path) {
    boost::system::error_code ignored;
    if (!path.empty() && fs::is_directory(path, ignored)) fs::remove_all(path, ignored);
}

}  // namespace dp
