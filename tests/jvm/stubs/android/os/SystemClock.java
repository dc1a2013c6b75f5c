package android.os;

public final class SystemClock {
    public static void sleep(long milliseconds) {}
}
