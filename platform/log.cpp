#include <android/log.h>

#include <cstdarg>
#include <cstdio>

namespace {

__android_logger_function currentLogger = __android_log_stderr_logger;

}  // namespace

void __android_log_set_logger(__android_logger_function logger) {
    currentLogger = logger;
}

void __android_log_stderr_logger(const __android_log_message* message) {
    static constexpr char kLetters[] = "??VDIWEF?";
    const bool known = message->priority >= 0 && message->priority <= ANDROID_LOG_SILENT;
    std::fprintf(stderr, "%c/%s: %s\n", known ? kLetters[message->priority] : '?', message->tag, message->message);
}

int __android_log_print(int prio, const char* tag, const char* fmt, ...) {
    // Longer texts are truncated, as on Android.
    char text[4000];
    std::va_list arguments;
    va_start(arguments, fmt);
    std::vsnprintf(text, sizeof text, fmt, arguments);
    va_end(arguments);
    const __android_log_message message = {sizeof message, 0, prio, tag, nullptr, 0, text};
    currentLogger(&message);
    return 1;
}
