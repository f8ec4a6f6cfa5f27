#pragma once

namespace dp::tool {

// The user asked the program to stop.
struct Interrupted {
    int signal;
};

// From here on an interrupt only takes note of itself, so that the temporary directory can be
// removed first; a second one ends the program at once. Writing to a closed pipe is no signal.
void noteInterrupts();

// Throws Interrupted after an interrupt.
void stopIfInterrupted();

}  // namespace dp::tool
