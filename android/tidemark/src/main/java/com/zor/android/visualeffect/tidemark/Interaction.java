package com.zor.android.visualeffect.tidemark;

/** The effect of touches. */
public enum Interaction {
    /** A finger draws, and no view around the water can take it away for scrolling. */
    PRESS,
    /** A finger draws until a list or a pager around the water begins to scroll with it. */
    PRESS_OR_SCROLL,
    /** Touches do not reach the water; the view treats them as any other view does. */
    NONE
}
