// replay PATH...: runs a fuzz target once over every file named, or below every directory named,
// without a fuzzer. What is wrong ends the process; the name of the file is printed first.

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include <boost/filesystem.hpp>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

namespace fs = boost::filesystem;

void run(const fs::path& path) {
    std::string content;
    fs::load_string_file(path, content);
    std::printf("%s\n", path.filename().c_str());
    std::fflush(stdout);
    LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(content.data()), content.size());
}

}  // namespace

int main(int argc, char** argv) {
    std::vector<fs::path> files;
    for (int i = 1; i < argc; ++i) {
        if (!fs::is_directory(argv[i])) files.push_back(fs::absolute(argv[i]));
        if (fs::is_directory(argv[i]))
            for (const fs::path& entry : fs::recursive_directory_iterator(fs::absolute(argv[i])))
                if (fs::is_regular_file(entry)) files.push_back(entry);
    }
    for (const fs::path& file : files) run(file);
    std::printf("%zu inputs\n", files.size());
    return files.empty() ? 1 : 0;
}
