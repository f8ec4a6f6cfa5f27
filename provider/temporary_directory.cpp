#include "dpxlsx/provider/temporary_directory.h"

#include <unistd.h>

#include <limits>
#include <sys/stat.h>
#include <sys/statvfs.h>

#include <boost/filesystem.hpp>

#include "dpxlsx/readers/xml/temporary_path.h"

namespace dp {

namespace fs = boost::filesystem;

std::string makePrivateDirectory() {
    // The name is complete before the directory is made: nothing may fail afterwards, or the
    // directory would be left behind.
    std::string directory = unusedTemporaryPath();
    if (!directory.empty() && !makeOwnDirectory(directory)) directory.clear();
    return directory;
}

bool makeOwnDirectory(const std::string& path) {
    // The mode of mkdir keeps others out from the first moment on; chmod adds what the umask
    // removed.
    if (::mkdir(path.c_str(), S_IRWXU) != 0) return false;
    if (::chmod(path.c_str(), S_IRWXU) == 0) return true;
    ::rmdir(path.c_str());
    return false;
}

std::uint64_t freeSpace(const std::string& directory) {
    struct statvfs status {};
    // A file system without blocks has no limit, or one that it does not tell.
    if (::statvfs(directory.c_str(), &status) != 0 || status.f_blocks == 0)
        return std::numeric_limits<std::uint64_t>::max();
    return std::uint64_t{status.f_bavail} * status.f_frsize;
}

void removeDirectoryAndContents(const std::string& path) {
    boost::system::error_code ignored;
    if (!path.empty() && fs::is_directory(path, ignored)) fs::remove_all(path, ignored);
}

}  // namespace dp
