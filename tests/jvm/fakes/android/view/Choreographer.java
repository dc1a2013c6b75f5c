package android.view;

import android.os.Handler;
import android.os.Looper;

import java.util.HashMap;
import java.util.Map;
import java.util.concurrent.ConcurrentHashMap;

/** The refresh of a display, which a test triggers. */
public final class Choreographer {
    public interface FrameCallback {
        void doFrame(long frameTimeNanos);
    }

    private static final Choreographer DISPLAY = new Choreographer();
    private final Map<FrameCallback, Looper> awaiting = new ConcurrentHashMap<>();

    public static Choreographer getInstance() {
        return DISPLAY;
    }

    public void postFrameCallback(FrameCallback callback) {
        awaiting.put(callback, Looper.myLooper());
    }

    /** Posts the callbacks. Returns false if there are none. */
    public static boolean refresh(long nanos) {
        Map<FrameCallback, Looper> called = new HashMap<>(DISPLAY.awaiting);
        called.forEach((callback, looper) -> {
            DISPLAY.awaiting.remove(callback);
            new Handler(looper).post(() -> callback.doFrame(nanos));
        });
        return !called.isEmpty();
    }
}
