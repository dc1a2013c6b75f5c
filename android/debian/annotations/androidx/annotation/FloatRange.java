package androidx.annotation;

public @interface FloatRange {
    double from();

    double to();
}
