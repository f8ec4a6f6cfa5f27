#pragma once

#include <string>
#include <string_view>

namespace dp::tool {

// Thrown when the program that reads standard output has ended, as `head` does: the rest of the
// output is not needed.
struct ClosedPipe {};

// A file that is written, or standard output. Every write is checked: a failing one throws a
// Failure, or ClosedPipe. A regular file is written aside, beside its place, and takes it in
// finish(): what ends early leaves neither half a file nor harms one that was there.
class Output {
  public:
    // "-" is standard output.
    explicit Output(const std::string& path);
    // Keeps what is written in memory, for text().
    static Output inMemory() { return {}; }
    ~Output();
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    void write(std::string_view text);
    // Writes what is still buffered.
    void flush();
    // Writes what is still buffered and closes the file, which is not in its place yet.
    void close();
    // Closes the file and puts it in its place. To be called at the end: otherwise the output is
    // lost without an error.
    void finish();
    // What has not been written yet.
    const std::string& text() const { return buffer_; }

  private:
    Output() = default;
    int open();
    int openAside();
    [[noreturn]] void fail(int error) const;

    std::string path_;
    std::string place_;  // the file behind path_, when that is a symbolic link
    std::string aside_;  // where it is written; empty when it is written in place
    int descriptor_ = -1;
    std::string buffer_;
};

}  // namespace dp::tool
