#include "dpxlsx/provider/archive.h"

#include <utility>

#include <minizip/ioapi.h>

namespace dp {

namespace {

extern "C" {

voidpf openFile(voidpf file, const void* path, int) {
    std::FILE* const opened = std::fopen(static_cast<const char*>(path), "rbe");
    *static_cast<std::FILE**>(file) = opened;
    return opened;
}

int closeFile(voidpf file, voidpf) {
    return std::fclose(std::exchange(*static_cast<std::FILE**>(file), nullptr));
}

// Reports an unexpected end of the file as an error. Left to itself, minizip continues with the
// preceding bytes (1.1) or zeros (1.3), and so opens archives that are cut short, other ones in
// each version.
int failed(voidpf, voidpf stream) {
    std::FILE* const file = static_cast<std::FILE*>(stream);
    return std::ferror(file) != 0 || std::feof(file) != 0;
}

}  // extern "C"

unzFile openArchive(const std::string& path, std::FILE** file) {
    zlib_filefunc64_def functions{};
    fill_fopen64_filefunc(&functions);
    functions.zopen64_file = openFile;
    functions.zclose_file = closeFile;
    functions.zerror_file = failed;
    functions.opaque = file;
    return unzOpen2_64(path.c_str(), &functions);
}

}  // namespace

Archive::Archive(const std::string& path) : handle_(openArchive(path, &file_)) {}

Archive::~Archive() {
    if (handle_) close();
    if (file_) std::fclose(file_);
}

int Archive::close() { return unzClose(std::exchange(handle_, nullptr)); }

}  // namespace dp
