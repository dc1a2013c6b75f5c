// libjnigraphics over the Java class that stands in for android.graphics.Bitmap.
#include <android/bitmap.h>

static int integer(JNIEnv* env, jobject bitmap, const char* getter) {
    const jclass type = env->GetObjectClass(bitmap);
    const jint value = env->CallIntMethod(bitmap, env->GetMethodID(type, getter, "()I"));
    if (env->ExceptionCheck()) env->FatalError(getter);
    env->DeleteLocalRef(type);
    return value;
}

static void count(JNIEnv* env, jobject bitmap, const char* counter, int change) {
    const jclass type = env->GetObjectClass(bitmap);
    const jfieldID field = env->GetStaticFieldID(type, counter, "I");
    env->SetStaticIntField(type, field, env->GetStaticIntField(type, field) + change);
    env->DeleteLocalRef(type);
}

int AndroidBitmap_getInfo(JNIEnv* env, jobject bitmap, AndroidBitmapInfo* info) {
    if (!bitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    *info = {};
    info->width = static_cast<uint32_t>(integer(env, bitmap, "getWidth"));
    info->height = static_cast<uint32_t>(integer(env, bitmap, "getHeight"));
    info->stride = info->width * 4;
    info->format = ANDROID_BITMAP_FORMAT_RGBA_8888;
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_lockPixels(JNIEnv* env, jobject bitmap, void** address) {
    if (!bitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    const jclass type = env->GetObjectClass(bitmap);
    const jobject buffer = env->GetObjectField(bitmap, env->GetFieldID(type, "pixels", "Ljava/nio/ByteBuffer;"));
    env->DeleteLocalRef(type);
    if (!buffer) return ANDROID_BITMAP_RESULT_ALLOCATION_FAILED;
    *address = env->GetDirectBufferAddress(buffer);
    env->DeleteLocalRef(buffer);
    count(env, bitmap, "locks", 1);
    count(env, bitmap, "locksMade", 1);
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_unlockPixels(JNIEnv* env, jobject bitmap) {
    if (!bitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    count(env, bitmap, "locks", -1);
    return ANDROID_BITMAP_RESULT_SUCCESS;
}
