package android.os;

public class HandlerThread extends Thread {
    private final Looper looper = new Looper();

    public HandlerThread(String name, int priority) {
        super(name);
        setDaemon(true);
    }

    @Override
    public void run() {
        try {
            looper.run();
        } catch (InterruptedException e) {
            throw new AssertionError(e);
        }
    }

    public Looper getLooper() {
        return looper;
    }
}
