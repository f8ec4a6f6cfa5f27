#pragma once

namespace dp::tool {

// Thrown when the user has asked the program to stop.
struct Interrupted {
    int signal;
};

// From now on an interrupt is only recorded, so that the temporary directory can be removed before
// the program ends; a second interrupt ends it at once. Writing to a closed pipe fails instead of
// raising a signal.
void noteInterrupts();

bool isInterrupted();

// Throws Interrupted after an interrupt.
void stopIfInterrupted();

}  // namespace dp::tool
