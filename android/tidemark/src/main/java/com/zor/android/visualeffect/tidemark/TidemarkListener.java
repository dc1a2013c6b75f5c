package com.zor.android.visualeffect.tidemark;

import androidx.annotation.MainThread;
import androidx.annotation.NonNull;

/**
 * Called by a {@link TidemarkView} on the main thread when its state changes. A listener that is set late is called at
 * once with the last failure and the current state.
 */
@MainThread
public interface TidemarkListener {
    /** The kind of a failure. */
    enum Failure {
        /** The device has no OpenGL ES 2.0. The view stays empty. */
        NO_OPENGL,
        /** The app contains no native library for the device's processor. The view stays empty. */
        NO_LIBRARY,
        /** A picture cannot be read or decoded, or was recycled. The view keeps the picture before. */
        PICTURE
    }

    /** The first frame is shown. Called once, before {@link #onCalm}. */
    default void onReady() {}

    /** The water is calm: no frames are drawn until something changes. */
    default void onCalm() {}

    /** The water moves again. */
    default void onWake() {}

    /** Another view has begun to draw. This one keeps its last frame until {@link #onWake} or {@link #onCalm}. */
    default void onRest() {}

    /**
     * Something has failed.
     *
     * @param failure the kind of the failure
     * @param message the details in English, for a log
     */
    default void onFailure(@NonNull Failure failure, @NonNull String message) {}
}
