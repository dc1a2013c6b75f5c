package android.os;

import java.util.concurrent.BlockingQueue;
import java.util.concurrent.LinkedBlockingQueue;

/** The queue of calls for a thread. */
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

    /** Makes the calls for the main thread, which is the thread of the test. Returns false if there were none. */
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
