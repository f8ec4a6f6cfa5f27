#include "readers/file_copy.h"

#include <unistd.h>

#include <filesystem>
#include <system_error>

namespace dp {

bool copyFile(const std::string& source, const std::string& target) {
    namespace fs = std::filesystem;
    const fs::path from(source);
    const fs::path to(target);
    std::error_code error;
    try {
        if (fs::copy_file(from, to, fs::copy_options::none, error) && !error)
            fs::permissions(to, fs::perms::owner_read | fs::perms::owner_write, error);
    } catch (...) {
        ::unlink(to.c_str());
        throw;
    }
    if (error && error != std::errc::file_exists) ::unlink(to.c_str());
    return !error;
}

}  // namespace dp
