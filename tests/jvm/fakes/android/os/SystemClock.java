package android.os;

/** A clock that a test sets. */
public final class SystemClock {
    public static volatile long nanos;

    public static long uptimeMillis() {
        return nanos / 1000000;
    }
}
