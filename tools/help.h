#pragma once

namespace dp::tool {

// Usage, every option by group, and the exit codes, for a screen of 40 lines of 80 characters.
const char* helpText();

}  // namespace dp::tool
