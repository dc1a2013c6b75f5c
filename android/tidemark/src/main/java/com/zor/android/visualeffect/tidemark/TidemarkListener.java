package com.zor.android.visualeffect.tidemark;

import org.jetbrains.annotations.NotNull;

/** Hears on the main thread what becomes of the water. */
public interface TidemarkListener {
    /** Why the view stays empty, or as it was. */
    enum Failure {
        /** The device has no OpenGL ES 2.0. */
        NO_OPENGL,
        /** The app holds no native library for the device's processor. */
        NO_LIBRARY,
        /** A side of the light is longer than the device's largest texture; the earlier pictures stay. */
        PICTURE_TOO_LARGE
    }

    /** A frame was shown after which nothing moves: the next one comes when something changes. */
    default void onCalm() {}

    /**
     * Nothing else tells the app.
     *
     * @param failure what to act upon
     * @param message what to log, in English
     */
    default void onFailure(@NotNull Failure failure, @NotNull String message) {}
}
