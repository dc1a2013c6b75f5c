package androidx.annotation;

public @interface DrawableRes {}
