// Does not compile if Java declares other types for a method than the library does.
#define Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move javaMove
#include "com_zor_android_visualeffect_tidemark_JniTidemarkRender.h"
#undef Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move
#include "jni/natives.h"

// The library returns 32 bits, of which Java reads the low byte as a boolean.
template <class... Arguments>
static constexpr bool takeTheSame(jboolean (*)(Arguments...), jint (*)(Arguments...)) {
    return true;
}
static_assert(takeTheSame(javaMove, Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move));
