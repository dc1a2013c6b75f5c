#include "host/log_filter.h"

#include <android/log.h>

#include <string_view>

namespace tidemark {

namespace {

// The library logs these two steps of each set-up at error priority although they are no errors.
bool marksSetUp(std::string_view message) {
    return message == "CreateSurface" || message == "zorloadShaderScript";
}

void passFailures(const __android_log_message* message) {
    if (message->priority >= ANDROID_LOG_ERROR && !marksSetUp(message->message)) __android_log_stderr_logger(message);
}

}  // namespace

void quietenLog() {
    __android_log_set_logger(passFailures);
}

}  // namespace tidemark
