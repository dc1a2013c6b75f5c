#include "preview/interrupt.h"

#include <csignal>

namespace tidemark {

static volatile std::sig_atomic_t recorded = 0;

void recordInterrupts() {
    struct sigaction action = {};
    action.sa_handler = [](int) { recorded = 1; };
    action.sa_flags = SA_RESTART | static_cast<int>(SA_RESETHAND);
    sigaction(SIGINT, &action, nullptr);
    sigaction(SIGTERM, &action, nullptr);
}

bool interrupted() {
    return recorded != 0;
}

}  // namespace tidemark
