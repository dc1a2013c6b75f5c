package androidx.annotation;

public @interface Nullable {}
