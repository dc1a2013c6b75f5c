// The native methods of NativeWater.java. Each calls the method of the same name in host/live_water.h.
#include <jni.h>

#include "host/live_water.h"
#include "host/look_values.h"
#include "host/native_names.h"

using namespace tidemark;

namespace {

// The native part of a NativeWater. Java owns only the pictures.
struct Water {
    explicit Water(std::uint32_t seed)
        : live({[this](PictureSlot slot, int width, int height) { transfer(slot, width, height); }, {}}, seed) {}

    void transfer(PictureSlot slot, int width, int height);

    LiveWater live;
    Look look;  // set by setLookValue(), used by applyLook()

    // Valid while frame() runs.
    JNIEnv* env = nullptr;
    jobject self = nullptr;
};

// Identifiers of the class's members, which are the same for all objects.
jfieldID handleField;
jmethodID pictureMethod;

Water& waterOf(JNIEnv* env, jobject self) {
    return *reinterpret_cast<Water*>(env->GetLongField(self, handleField));
}

LiveWater& liveOf(JNIEnv* env, jobject self) {
    return waterOf(env, self).live;
}

void Water::transfer(PictureSlot slot, int width, int height) {
    const jobject bitmap = env->CallObjectMethod(self, pictureMethod, static_cast<jint>(slot), width, height);
    if (env->ExceptionCheck() || !bitmap) return;  // the library keeps the picture that it has
    constexpr void (*kMethods[])(JNIEnv*, jobject, jobject) = {
        native::transferPortraitBGBitmap, native::transferLandscapeBGBitmap, native::transferWaterBitmap};
    kMethods[static_cast<int>(slot)](env, nullptr, bitmap);
    env->DeleteLocalRef(bitmap);
}

}  // namespace

#define NATIVE(result, method) \
    extern "C" JNIEXPORT result JNICALL Java_com_zor_android_visualeffect_tidemark_NativeWater_##method

NATIVE(jlong, create)(JNIEnv* env, jclass type, jint seed) {
    handleField = env->GetFieldID(type, "handle", "J");
    pictureMethod = env->GetMethodID(type, "picture", "(III)Landroid/graphics/Bitmap;");
    return reinterpret_cast<jlong>(new Water(static_cast<std::uint32_t>(seed)));
}
NATIVE(void, destroy)(JNIEnv* env, jobject self) {
    delete reinterpret_cast<Water*>(env->GetLongField(self, handleField));  // none where create() failed
}
NATIVE(void, setView)(JNIEnv* env, jobject self, jdouble width, jdouble height, jdouble density, jdouble now) {
    liveOf(env, self).setView(width, height, density, now);
}
NATIVE(void, setQuality)(JNIEnv* env, jobject self, jint quality) {
    liveOf(env, self).setQuality(static_cast<Quality>(quality));
}
NATIVE(jint, width)(JNIEnv* env, jobject self) {
    return liveOf(env, self).width();
}
NATIVE(jint, height)(JNIEnv* env, jobject self) {
    return liveOf(env, self).height();
}
NATIVE(void, resized)(JNIEnv* env, jobject self) {
    liveOf(env, self).resized();
}

// Returns false if there is no value of this name, or if it must not have this value. applyLook() uses the values.
NATIVE(jboolean, setLookValue)(JNIEnv* env, jobject self, jstring name, jdouble value) {
    char characters[64] = {};
    const jsize length = env->GetStringUTFLength(name);
    if (length >= static_cast<jsize>(sizeof characters)) return JNI_FALSE;
    env->GetStringUTFRegion(name, 0, env->GetStringLength(name), characters);
    const LookField* const field = fieldNamed(characters);
    return field && setValue(waterOf(env, self).look, *field, value);
}
NATIVE(void, applyLook)(JNIEnv* env, jobject self) {
    Water& water = waterOf(env, self);
    water.live.setLook(water.look);
}
NATIVE(void, setInk)(JNIEnv* env, jobject self, jboolean withInk) {
    liveOf(env, self).setInk(withInk);
}
NATIVE(void, setRain)(JNIEnv* env, jobject self, jboolean falling) {
    liveOf(env, self).setRain(falling);
}
NATIVE(void, setBreezeAlways)(JNIEnv* env, jobject self, jboolean always) {
    liveOf(env, self).setBreezeAlways(always);
}

// Returns an opaque colour in Android's form, ARGB.
NATIVE(jint, shade)(JNIEnv* env, jobject self, jint slot, jfloat brightness) {
    const Shade shade = liveOf(env, self).shade(static_cast<PictureSlot>(slot), brightness);
    const auto channel = [](float share) { return static_cast<std::uint32_t>(share * 255.0f + 0.5f); };
    const std::uint32_t rgb = channel(shade.red) << 16 | channel(shade.green) << 8 | channel(shade.blue);
    return static_cast<jint>(0xff000000u | rgb);
}
NATIVE(void, clearInk)(JNIEnv* env, jobject self) {
    liveOf(env, self).clearInk();
}
NATIVE(void, touch)
(JNIEnv* env, jobject self, jint action, jfloat x, jfloat y, jboolean isStylus, jfloat pressure, jdouble time) {
    liveOf(env, self).touch(static_cast<TouchAction>(action), x, y, isStylus ? penWeight(pressure) : 1.0f, time);
}
NATIVE(void, splash)(JNIEnv* env, jobject self, jfloat x, jfloat y, jfloat weight, jboolean withInk) {
    liveOf(env, self).splash(x, y, weight, withInk);
}
NATIVE(void, picturesChanged)(JNIEnv* env, jobject self, jint which) {
    liveOf(env, self).picturesChanged(static_cast<unsigned>(which));
}
NATIVE(void, redraw)(JNIEnv* env, jobject self) {
    liveOf(env, self).redraw();
}
NATIVE(void, renewContext)(JNIEnv* env, jobject self) {
    liveOf(env, self).renewContext();
}
NATIVE(jint, frame)(JNIEnv* env, jobject self, jdouble now) {
    Water& water = waterOf(env, self);
    water.env = env;
    water.self = self;
    return static_cast<jint>(water.live.frame(now));
}
NATIVE(jdouble, due)(JNIEnv* env, jobject self) {
    return liveOf(env, self).due();
}
