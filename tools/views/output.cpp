#include "tools/views/output.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "tools/host/exit_code.h"

namespace dp::tool {

namespace {

constexpr size_t kBufferSize = 1 << 16;  // bytes

int openForWriting(const std::string& path) {
    return path == "-" ? STDOUT_FILENO
                       : open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666);
}

}  // namespace

Output::Output(const std::string& path) : path_(path), descriptor_(openForWriting(path)) {
    if (descriptor_ < 0) fail(errno);
}

Output::~Output() {
    if (descriptor_ >= 0 && descriptor_ != STDOUT_FILENO) close(descriptor_);
}

void Output::write(std::string_view text) {
    buffer_.append(text);
    if (buffer_.size() >= kBufferSize) flush();
}

void Output::finish() {
    flush();
    if (descriptor_ == STDOUT_FILENO) return;
    const int closing = descriptor_;
    descriptor_ = -1;
    if (close(closing) != 0) fail(errno);
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
