// The methods as Java declares them beside the methods as the library does: other types do not compile.
#define Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move javaMove
#include "com_zor_android_visualeffect_tidemark_JniTidemarkRender.h"
#undef Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move
#include "jni/natives.h"

// Java's boolean is the low byte of the 32 bits that the library fills.
template <class... Arguments>
static constexpr bool takeTheSame(jboolean (*)(Arguments...), jint (*)(Arguments...)) {
    return true;
}
static_assert(takeTheSame(javaMove, Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move));
