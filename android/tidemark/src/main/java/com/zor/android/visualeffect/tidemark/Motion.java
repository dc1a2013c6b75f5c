package com.zor.android.visualeffect.tidemark;

/** Whether the water moves by itself. */
public enum Motion {
    /** {@link #REDUCED} where the user has switched the system's animations off, otherwise {@link #FULL}. */
    AUTO,
    /** It rains, and the first drop falls, where they are switched on. */
    FULL,
    /** Only touches and calls move the water. */
    REDUCED
}
