package com.zor.android.visualeffect.tidemark;

/** How many pixels are drawn, at most, for each density-independent pixel of a side. */
public enum Quality {
    /** Two, and fewer where frames would miss the display's pace. */
    AUTO,
    /** One. */
    LOW,
    /** Two. */
    MEDIUM,
    /** Three. */
    HIGH
}
