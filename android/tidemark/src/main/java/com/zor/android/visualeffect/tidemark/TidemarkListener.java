package com.zor.android.visualeffect.tidemark;

/** Hears on the main thread what becomes of the water. */
public interface TidemarkListener {
    enum Failure {
        /** The device has no OpenGL ES 2.0. */
        NO_OPENGL,
        /** The app holds no native library for the device's processor. */
        NO_LIBRARY,
        /** A side of a picture is longer than the device's largest texture; the earlier pictures stay. */
        PICTURE_TOO_LARGE
    }

    /** A frame was shown after which nothing moves: the next one comes when something changes. */
    default void onCalm() {}

    /** Nothing else tells the app: the view stays empty, or as it was. */
    default void onFailure(Failure failure, String message) {}
}
