package com.zor.android.visualeffect.tidemark;

import androidx.annotation.MainThread;
import androidx.annotation.NonNull;

/**
 * Hears what becomes of the water of a {@link TidemarkView}. All methods are called on the main thread. A listener that is
 * set late hears at once of the state that the view is in, and of the last failure.
 */
@MainThread
public interface TidemarkListener {
    /** Why the view stays empty, or as it was. */
    enum Failure {
        /** The device has no OpenGL ES 2.0. */
        NO_OPENGL,
        /** The app holds no native library for the device's processor. */
        NO_LIBRARY,
        /** A picture cannot be read or decoded, or was recycled; the earlier pictures stay. */
        PICTURE
    }

    /** The first frame is shown. Called once, before {@link #onCalm}. */
    default void onReady() {}

    /** The water has come to rest: no frames are drawn until something changes. */
    default void onCalm() {}

    /** The water moves again. */
    default void onWake() {}

    /** Another view has begun to draw. This one keeps its last picture until {@link #onWake} or {@link #onCalm}. */
    default void onRest() {}

    /**
     * Something failed, of which nothing else tells the app.
     *
     * @param failure what to act upon
     * @param message what to log, in English
     */
    default void onFailure(@NonNull Failure failure, @NonNull String message) {}
}
