package com.zor.android.visualeffect.tidemark;

/** Keeps the state of a view's water and the last failure, and calls the app's listener. Used on the main thread. */
abstract class ListenerNotifier implements TidemarkRenderer.Listener {
    private TidemarkListener listener;
    private TidemarkRenderer.State state = TidemarkRenderer.State.NOT_READY;
    private boolean isReady;  // a frame was shown
    private TidemarkListener.Failure failure;
    private String message;
    private boolean isBroken;

    /** Called once. */
    abstract void firstFrameShown();

    void setListener(TidemarkListener listener) {
        this.listener = listener;
        if (listener == null) return;
        if (failure != null) listener.onFailure(failure, message);
        if (isReady) listener.onReady();
        if (state == TidemarkRenderer.State.CALM) listener.onCalm();
        if (state == TidemarkRenderer.State.RESTING) listener.onRest();
    }

    /** Whether the view cannot draw on this device. */
    boolean isBroken() {
        return isBroken;
    }

    @Override
    public void stateChanged(TidemarkRenderer.State next) {
        boolean rests = next == TidemarkRenderer.State.RESTING;
        boolean isFirst = !rests && !isReady;
        state = next;
        isReady |= isFirst;
        if (isFirst) firstFrameShown();
        if (listener == null) return;
        if (isFirst) listener.onReady();
        if (rests) {
            listener.onRest();
        } else if (next == TidemarkRenderer.State.CALM) {
            listener.onCalm();
        } else if (!isFirst) {
            listener.onWake();
        }
    }

    @Override
    public void failed(TidemarkListener.Failure failure, String message) {
        this.failure = failure;
        this.message = message;
        isBroken |= failure != TidemarkListener.Failure.PICTURE;
        if (listener != null) listener.onFailure(failure, message);
    }
}
