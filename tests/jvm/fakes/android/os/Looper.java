package android.os;

import java.util.concurrent.BlockingQueue;
import java.util.concurrent.LinkedBlockingQueue;

/** The calls that wait for a thread. */
public final class Looper {
    private static final Looper MAIN = new Looper();
    private static final ThreadLocal<Looper> MINE = new ThreadLocal<>();

    final BlockingQueue<Runnable> calls = new LinkedBlockingQueue<>();

    public static Looper getMainLooper() {
        return MAIN;
    }

    public static Looper myLooper() {
        return MINE.get();
    }

    /** The main thread is a test's: makes the calls that wait for it, and says whether there were any. */
    public static boolean runMain() {
        boolean any = false;
        for (Runnable call; (call = MAIN.calls.poll()) != null; any = true) call.run();
        return any;
    }

    void run() throws InterruptedException {
        MINE.set(this);
        while (true) calls.take().run();
    }
}
