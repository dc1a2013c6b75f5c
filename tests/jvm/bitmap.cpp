// libjnigraphics for the fake of android.graphics.Bitmap.
#include <android/bitmap.h>

static uint32_t side(JNIEnv* env, jobject bitmap, const char* name) {
    return static_cast<uint32_t>(env->GetIntField(bitmap, env->GetFieldID(env->GetObjectClass(bitmap), name, "I")));
}

static void count(JNIEnv* env, jobject bitmap, const char* counter, int change) {
    const jclass type = env->GetObjectClass(bitmap);
    const jfieldID field = env->GetStaticFieldID(type, counter, "I");
    env->SetStaticIntField(type, field, env->GetStaticIntField(type, field) + change);
}

int AndroidBitmap_getInfo(JNIEnv* env, jobject bitmap, AndroidBitmapInfo* info) {
    const uint32_t width = side(env, bitmap, "width");
    *info = {width, side(env, bitmap, "height"), 4 * width, ANDROID_BITMAP_FORMAT_RGBA_8888, 0};
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_lockPixels(JNIEnv* env, jobject bitmap, void** address) {
    const jfieldID pixels = env->GetFieldID(env->GetObjectClass(bitmap), "pixels", "Ljava/nio/ByteBuffer;");
    *address = env->GetDirectBufferAddress(env->GetObjectField(bitmap, pixels));
    count(env, bitmap, "locks", 1);
    count(env, bitmap, "locksMade", 1);
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_unlockPixels(JNIEnv* env, jobject bitmap) {
    count(env, bitmap, "locks", -1);
    return ANDROID_BITMAP_RESULT_SUCCESS;
}
