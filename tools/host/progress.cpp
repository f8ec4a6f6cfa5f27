#include "tools/host/progress.h"

#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>

#include "tools/views/terminal.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

constexpr double kPause = 0.1;  // seconds between two lines

double now() {
    const auto passed = std::chrono::steady_clock::now().time_since_epoch();
    return std::chrono::duration<double>(passed).count();
}

}  // namespace

Progress::Progress(const std::string& turn) : turn_(turn), terminal_(isatty(STDERR_FILENO) == 1) {}

Progress::~Progress() { erase(); }

void Progress::opening(const std::string& book) { show("Opening " + book); }

void Progress::opening(const std::string& book, double done) {
    const int percent = static_cast<int>(done * 100);
    show("Opening " + book, ": " + std::to_string(percent) + " %");
}

void Progress::column(const std::string& worksheet, size_t number, size_t count) {
    if (now() - lastShown_ < kPause) return;
    show(worksheet + ": column " + std::to_string(number) + " of " + std::to_string(count));
}

void Progress::erase() {
    if (shown_) std::fputs("\r\033[K", stderr);
    shown_ = false;
}

void Progress::show(const std::string& text, const std::string& end) {
    if (!terminal_) return;
    // A line that wraps cannot be erased.
    const int width = terminalWidth(STDERR_FILENO).value_or(80) - 1;
    const int room = std::max(width - static_cast<int>(end.size()), 0);
    std::fprintf(stderr, "\r\033[K%s%s", cutToWidth(printable(turn_ + text), room).c_str(),
                 end.c_str());
    shown_ = true;
    lastShown_ = now();
}

}  // namespace dp::tool
