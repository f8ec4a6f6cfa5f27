#include "dpxlsx/readers/xml/file_copy.h"

#include <unistd.h>

#include <cstdint>
#include <filesystem>
#include <system_error>

namespace dp {

bool copyFile(const std::string& source, const std::string& target) {
    namespace fs = std::filesystem;
    const fs::path from(source);
    const fs::path to(target);
    std::error_code error;
    try {
        const std::uintmax_t size = fs::file_size(from, error);
        if (error) return false;
        fs::copy_file(from, to, fs::copy_options::none, error);
        if (error == std::errc::file_exists) return false;
        // The standard library of g++ 14 and later does not report an error when the source is
        // truncated during the copy.
        if (!error && fs::file_size(to, error) < size)
            error = std::make_error_code(std::errc::io_error);
        if (!error) fs::permissions(to, fs::perms::owner_read | fs::perms::owner_write, error);
    } catch (...) {
        ::unlink(to.c_str());
        throw;
    }
    if (error) ::unlink(to.c_str());
    return !error;
}

}  // namespace dp
