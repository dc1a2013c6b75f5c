package com.zor.android.visualeffect.tidemark;

/** How many pixels are drawn: at most so many for each density-independent pixel of a side, and no more than it has. */
public enum Quality {
    /** At most two, and fewer if frames take longer than the display's refresh. */
    AUTO,
    /** At most one. */
    LOW,
    /** At most two. */
    MEDIUM,
    /** At most three. */
    HIGH
}
