#include "tools/host/interrupt.h"

#include <signal.h>

#include <initializer_list>

namespace dp::tool {

namespace {

volatile sig_atomic_t noted = 0;

extern "C" void noteSignal(int signal) { noted = signal; }

}  // namespace

void noteInterrupts() {
    struct sigaction action = {};
    action.sa_handler = noteSignal;
    action.sa_flags = SA_RESTART | static_cast<int>(SA_RESETHAND);
    for (const int caught : {SIGINT, SIGTERM, SIGHUP}) {
        struct sigaction before = {};
        sigaction(caught, nullptr, &before);
        if (before.sa_handler != SIG_IGN) sigaction(caught, &action, nullptr);
    }
    signal(SIGPIPE, SIG_IGN);
}

bool isInterrupted() { return noted != 0; }

void stopIfInterrupted() {
    if (isInterrupted()) throw Interrupted{noted};
}

}  // namespace dp::tool
