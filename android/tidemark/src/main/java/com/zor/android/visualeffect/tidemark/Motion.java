package com.zor.android.visualeffect.tidemark;

/** Whether the water moves by itself. */
public enum Motion {
    /** {@link #REDUCED} where the user has switched the system's animations off, otherwise {@link #FULL}. */
    AUTO,
    /** It rains, the first drop falls, and a breeze follows a touch, where the view and its look say so. */
    FULL,
    /** Only touches and calls move the water. */
    REDUCED
}
