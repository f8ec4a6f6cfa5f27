#include "readers/file_copy.h"

#include <filesystem>
#include <system_error>

namespace dp {

bool copyFile(const std::string& source, const std::string& target) {
    namespace fs = std::filesystem;
    std::error_code error;
    if (!fs::copy_file(source, target, fs::copy_options::none, error) || error) return false;
    fs::permissions(target, fs::perms::owner_read | fs::perms::owner_write, error);
    return !error;
}

}  // namespace dp
