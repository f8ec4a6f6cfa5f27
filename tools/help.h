#pragma once

#include <string>

namespace CLI {
class App;
}

namespace dp::tool {

// Usage, the options by group, one line each, and the exit codes.
std::string helpText(const CLI::App& app);

}  // namespace dp::tool
