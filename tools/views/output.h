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
    ~Output();
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    void write(std::string_view text);
    // Writes what is still buffered and puts the file in its place. To be called at the end:
    // otherwise the output is lost without an error.
    void finish();

  private:
    int open();
    int openAside();
    void flush();
    [[noreturn]] void fail(int error) const;

    std::string path_;
    std::string place_;  // the file behind path_, when that is a symbolic link
    std::string aside_;  // where it is written; empty when it is written in place
    int descriptor_;
    std::string buffer_;
};

}  // namespace dp::tool
