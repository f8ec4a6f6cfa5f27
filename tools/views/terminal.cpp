#include "tools/views/terminal.h"

#include <unistd.h>

#include <cstdlib>
#include <sys/ioctl.h>

namespace dp::tool {

std::optional<int> terminalWidth(int descriptor) {
    if (const char* columns = std::getenv("COLUMNS")) {
        const int width = std::atoi(columns);
        if (width > 0) return width;
    }
    winsize size = {};
    if (ioctl(descriptor, TIOCGWINSZ, &size) == 0 && size.ws_col > 0) return size.ws_col;
    return std::nullopt;
}

}  // namespace dp::tool
