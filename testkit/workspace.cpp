#include "testkit/workspace.h"

#include <unistd.h>

#include <fstream>
#include <stdexcept>

namespace testkit {

namespace fs = boost::filesystem;

namespace {

fs::path newRoot(Workspace::Place place) {
    const fs::path memory = "/dev/shm";
    const bool inMemory = place == Workspace::Place::Memory && ::access(memory.c_str(), W_OK) == 0;
    return (inMemory ? memory : fs::temp_directory_path()) /
           fs::unique_path("dpxlsx-test-%%%%-%%%%");
}

}  // namespace

void writeFile(const std::string& path, const std::string& content) {
    fs::create_directories(fs::path(path).parent_path());
    std::ofstream file(path, std::ios::binary);
    file << content;
    if (!file.flush()) throw std::runtime_error("cannot write " + path);
}

Workspace::Workspace(Place place)
    : root_(newRoot(place)), variable_("TMPDIR", temporary().string()) {
    for (const fs::path& directory : {files(), temporary()}) fs::create_directories(directory);
}

Workspace::~Workspace() {
    boost::system::error_code ignored;
    fs::remove_all(root_, ignored);
}

std::string Workspace::write(const std::string& name, const std::string& content) const {
    writeFile(file(name), content);
    return file(name);
}

}  // namespace testkit
