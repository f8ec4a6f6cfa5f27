// replay PATH...: runs a fuzz target once for every file named, or below every directory named,
// without a fuzzer. An error ends the process; the name of the file is printed first. As under the
// fuzzer, the standard streams are redirected during each run, so that output is noticed.

#include <fcntl.h>
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include <boost/filesystem.hpp>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

namespace fs = boost::filesystem;

const int names = ::dup(STDOUT_FILENO);

// Defined by the sanitizers, if any are used.
extern "C" [[gnu::weak]] void __sanitizer_set_report_fd(void* descriptor);

void closeStreams() {
    static const std::intptr_t errors = ::dup(STDERR_FILENO);
    if (__sanitizer_set_report_fd) __sanitizer_set_report_fd(reinterpret_cast<void*>(errors));
    const int nowhere = ::open("/dev/null", O_WRONLY | O_CLOEXEC);
    ::dup2(nowhere, STDOUT_FILENO);
    ::dup2(nowhere, STDERR_FILENO);
    ::close(nowhere);
}

void run(const fs::path& path) {
    std::ifstream stream(path.string(), std::ios::binary);
    const std::string content(std::istreambuf_iterator<char>(stream), {});
    ::dprintf(names, "%s\n", path.filename().c_str());
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
    closeStreams();
    for (const fs::path& file : files) run(file);
    ::dprintf(names, "%zu inputs\n", files.size());
    return files.empty() ? 1 : 0;
}
