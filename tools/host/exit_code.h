#pragma once

#include <stdexcept>
#include <string>

namespace dp::tool {

// Exit codes of the program. Failures of the library have the digits of its result code.
enum ExitCode : int {
    kSuccess = 0,
    kReadFailure = 1,
    kUsage = 2,
    kOutputFailure = 3,
    kLibraryFailure = 4,
    kSystemFailure = 5,
    kMalformedWorkbook = 13,
    kNoSuchFile = 17,
    kTemporaryDirectory = 18,
    kNoPackage = 22,
    kNoWorkbook = 25
};

// A failure that ends the program. The text says which file, what is wrong and what to do.
class Failure : public std::runtime_error {
  public:
    Failure(ExitCode code, const std::string& text) : std::runtime_error(text), code_(code) {}

    ExitCode code() const { return code_; }

  private:
    ExitCode code_;
};

// The failure that a negative result code of opening or listing `book` stands for.
Failure readFailure(const std::string& book, long result);

// The failure that the current exception stands for, including exceptions of the library. To be
// called only in a catch block.
Failure currentFailure(const std::string& book);

// Prints a failure or a note as one line on standard error, with the program's name before it.
void printLine(const std::string& text);

}  // namespace dp::tool
