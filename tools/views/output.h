#pragma once

#include <string>
#include <string_view>

namespace dp::tool {

// Thrown when the program that reads standard output has ended, as `head` does: the rest of the
// output is not needed.
struct ClosedPipe {};

// A file that is written, or standard output. Every write is checked: a failing one throws a
// Failure, or ClosedPipe.
class Output {
  public:
    // "-" is standard output. A file is emptied.
    explicit Output(const std::string& path);
    ~Output();
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    void write(std::string_view text);
    // Writes what is still buffered. To be called at the end: otherwise the rest of the output is
    // lost without an error.
    void finish();

  private:
    void flush();
    [[noreturn]] void fail(int error) const;

    std::string path_;
    int descriptor_;
    std::string buffer_;
};

}  // namespace dp::tool
