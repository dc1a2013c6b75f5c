package com.zor.android.visualeffect.tidemark;

/** Whether the water moves without touches. */
public enum Motion {
    /** {@link #REDUCED} if the user has switched the system's animations off, otherwise {@link #FULL}. */
    AUTO,
    /** Rain and the first drop fall, and a breeze follows a touch, if the view's settings and its look have them. */
    FULL,
    /** Only touches, and calls of {@code drop} and {@code stroke}, move the water. */
    REDUCED
}
