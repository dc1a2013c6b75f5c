package com.zor.android.visualeffect.tidemark;

/** The effect of touches. */
public enum Interaction {
    /** A finger moves the water. A view around it cannot intercept the finger to scroll. */
    PRESS,
    /** A finger moves the water until a view around it intercepts the finger to scroll. */
    PRESS_OR_SCROLL,
    /** Touches do not move the water. The view treats them as any other view does. */
    NONE
}
