#include "tools/views/output.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <sys/stat.h>

#include "tools/host/exit_code.h"

namespace dp::tool {

namespace {

namespace fs = std::filesystem;

constexpr size_t kBufferSize = 1 << 16;  // bytes

std::string behindLinks(const std::string& path) {
    std::error_code error;
    const fs::path place = fs::canonical(path, error);
    return error ? path : place.string();
}

}  // namespace

Output::Output(const std::string& path) : path_(path), descriptor_(open()) {
    if (descriptor_ < 0) fail(errno);
}

Output::~Output() {
    if (descriptor_ >= 0 && descriptor_ != STDOUT_FILENO) ::close(descriptor_);
    if (!aside_.empty()) unlink(aside_.c_str());
}

int Output::open() {
    if (path_ == "-") return STDOUT_FILENO;
    struct stat there = {};
    const bool exists = stat(path_.c_str(), &there) == 0;
    if (exists && !S_ISREG(there.st_mode)) return ::open(path_.c_str(), O_WRONLY | O_CLOEXEC);
    // A file that must not be written is not replaced either.
    if (exists && access(path_.c_str(), W_OK) != 0) return -1;
    place_ = behindLinks(path_);
    const int descriptor = openAside();
    if (descriptor >= 0 && exists) static_cast<void>(fchmod(descriptor, there.st_mode & 07777));
    return descriptor;
}

int Output::openAside() {
    const fs::path folder = fs::path(place_).parent_path();
    const std::string name = ".dpxlsx-" + std::to_string(getpid()) + "-";
    for (int i = 0;; ++i) {
        aside_ = (folder / (name + std::to_string(i))).string();
        const int descriptor =
            ::open(aside_.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (descriptor >= 0) return descriptor;
        if (errno == EEXIST) continue;
        aside_.clear();
        return -1;
    }
}

void Output::write(std::string_view text) {
    buffer_.append(text);
    if (buffer_.size() >= kBufferSize && descriptor_ >= 0) flush();
}

void Output::close() {
    if (descriptor_ < 0) return;
    flush();
    if (descriptor_ == STDOUT_FILENO) return;
    const int closing = descriptor_;
    descriptor_ = -1;
    if (::close(closing) != 0) fail(errno);
}

void Output::finish() {
    close();
    if (aside_.empty()) return;
    if (std::rename(aside_.c_str(), place_.c_str()) != 0) fail(errno);
    aside_.clear();
}

void Output::flush() {
    for (size_t done = 0; done < buffer_.size();) {
        const ssize_t count = ::write(descriptor_, buffer_.data() + done, buffer_.size() - done);
        if (count >= 0) {
            done += static_cast<size_t>(count);
        } else if (errno != EINTR) {
            fail(errno);
        }
    }
    buffer_.clear();
}

void Output::fail(int error) const {
    if (error == EPIPE && descriptor_ == STDOUT_FILENO) throw ClosedPipe();
    const std::string name = path_ == "-" ? "standard output" : path_;
    throw Failure(kOutputFailure, name + ": cannot be written (" + std::strerror(error) +
                                      "); check the folder, its permissions and the free space");
}

}  // namespace dp::tool
