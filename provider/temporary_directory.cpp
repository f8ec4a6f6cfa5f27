#include "dpxlsx/provider/temporary_directory.h"

#include <unistd.h>

#include <filesystem>
#include <limits>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <system_error>

#include "dpxlsx/readers/xml/temporary_path.h"

namespace dp {

namespace {

constexpr mode_t kPermissions = S_IRWXU | S_IRWXG | S_IRWXO;

}  // namespace

std::string makePrivateDirectory() {
    // The name is complete before the directory is made: nothing may fail afterwards, or the
    // directory would be left behind.
    std::string directory = unusedTemporaryPath();
    if (!directory.empty() && !makeOwnDirectory(directory)) directory.clear();
    return directory;
}

bool makeOwnDirectory(const std::string& path) {
    // The mode of mkdir keeps others out from the first moment on; chmod, which a journaling file
    // system makes expensive, adds what an unusual umask removed.
    if (::mkdir(path.c_str(), S_IRWXU) != 0) return false;
    struct stat status {};
    const bool isPrivate =
        ::stat(path.c_str(), &status) == 0 && (status.st_mode & kPermissions) == S_IRWXU;
    if (isPrivate || ::chmod(path.c_str(), S_IRWXU) == 0) return true;
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
    // The standard library's takes what it removes from the directory's own list, where Boost's
    // asks the file system about each file.
    std::error_code ignored;
    if (!path.empty() && std::filesystem::is_directory(path, ignored))
        std::filesystem::remove_all(path, ignored);
}

}  // namespace dp
