package androidx.annotation;

public @interface MainThread {}
