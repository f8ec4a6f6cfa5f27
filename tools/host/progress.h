#pragma once

#include <cstddef>
#include <string>

namespace dp::tool {

// A progress line on standard error. It appears only on a terminal and is erased when the work is
// done.
class Progress {
  public:
    // `turn` precedes every line: the place of the workbook among several.
    explicit Progress(const std::string& turn);
    ~Progress();
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    void opening(const std::string& book);
    // `done` is from 0 to 1.
    void opening(const std::string& book, double done);
    // `number` is 1-based. Prints at most ten times a second.
    void column(const std::string& worksheet, size_t number, size_t count);
    void erase();

  private:
    // Text that does not fit is cut before `end`.
    void show(const std::string& text, const std::string& end = "");

    std::string turn_;
    bool terminal_;
    bool shown_ = false;
    double lastShown_ = 0;  // seconds
};

}  // namespace dp::tool
