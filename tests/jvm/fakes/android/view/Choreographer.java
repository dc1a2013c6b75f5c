package android.view;

import java.util.Set;
import java.util.concurrent.ConcurrentHashMap;

/** Of a display that refreshes when a test says so. */
public final class Choreographer {
    public interface FrameCallback {
        void doFrame(long frameTimeNanos);
    }

    private static final Choreographer DISPLAY = new Choreographer();
    private final Set<FrameCallback> awaiting = ConcurrentHashMap.newKeySet();

    public static Choreographer getInstance() {
        return DISPLAY;
    }

    public void postFrameCallback(FrameCallback callback) {
        awaiting.add(callback);
    }

    public void removeFrameCallback(FrameCallback callback) {
        awaiting.remove(callback);
    }

    /** Whether somebody awaited it. */
    public boolean refresh(long nanos) {
        FrameCallback[] called = awaiting.toArray(new FrameCallback[0]);
        for (FrameCallback callback : called) {
            awaiting.remove(callback);
            callback.doFrame(nanos);
        }
        return called.length > 0;
    }
}
