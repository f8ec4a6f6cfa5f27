#pragma once

#include <string>
#include <string_view>

namespace dp::tool {

// The reader of our standard output has gone away, as `head` does: nobody waits for the rest.
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
    // Writes what is still buffered. Without it the end of the output is lost, unreported.
    void finish();

  private:
    void flush();
    [[noreturn]] void fail(int error) const;

    std::string path_;
    int descriptor_;
    std::string buffer_;
};

}  // namespace dp::tool
