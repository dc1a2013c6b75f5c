package android.os;

public class Handler {
    private final Looper looper;

    public Handler(Looper looper) {
        this.looper = looper;
    }

    public final boolean post(Runnable call) {
        return looper.calls.add(call);
    }

    public final boolean postDelayed(Runnable call, long milliseconds) {
        return post(call);
    }
}
