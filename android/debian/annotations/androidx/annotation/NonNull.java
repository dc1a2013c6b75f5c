package androidx.annotation;

public @interface NonNull {}
