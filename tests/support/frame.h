// Calls the native methods of a frame with the arrays of a mesh of one cell.
#pragma once

#include "host/native_names.h"
#include "probes/copying_environment.h"

struct Frame {
    tidemark::FloatArray positions{12}, heights{12}, mvp{16}, velocity{4}, height{4};
    tidemark::ShortArray indices{6};

    void draw(JNIEnv* env = copyingEnvironment()) { draw(env, &positions, &heights, &indices, &mvp); }
    static void draw(
        JNIEnv* env, tidemark::FloatArray* p, tidemark::FloatArray* h, tidemark::ShortArray* i, tidemark::FloatArray* m,
        int indexCount = 6) {
        tidemark::native::onDrawFrame(
            env, nullptr, p, h, i, 2 * indexCount, 2 * indexCount, indexCount, m, 1, 1, 2, 2, 1.33f, 0.5f, 0.5f, 1.0f,
            0.1f, 0.2f, 0.3f, 1.0f, 1.0f, 40.0f, false);
    }
    static void setUp(int width, int height, bool withInk) {
        tidemark::native::onInitSetting(copyingEnvironment(), nullptr, width, height, withInk);
        tidemark::native::onInitGPU(copyingEnvironment(), nullptr);
    }
};
