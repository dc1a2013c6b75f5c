package android.os;

/** Of a main thread that has nothing else to do. */
public class Handler {
    public Handler(Looper looper) {}

    public final boolean post(Runnable call) {
        call.run();
        return true;
    }
}
