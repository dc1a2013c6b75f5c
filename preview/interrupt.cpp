#include "preview/interrupt.h"

#include <csignal>

namespace tidemark {

static volatile std::sig_atomic_t noted = 0;

void noteInterrupts() {
    struct sigaction action = {};
    action.sa_handler = [](int) { noted = 1; };
    action.sa_flags = SA_RESTART | static_cast<int>(SA_RESETHAND);
    sigaction(SIGINT, &action, nullptr);
    sigaction(SIGTERM, &action, nullptr);
}

bool interrupted() {
    return noted != 0;
}

}  // namespace tidemark
