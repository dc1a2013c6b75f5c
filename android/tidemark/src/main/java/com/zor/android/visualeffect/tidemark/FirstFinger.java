package com.zor.android.visualeffect.tidemark;

import android.view.MotionEvent;

/** Picks the touches of the finger that came down first; the water takes no others. */
final class FirstFinger {
    interface Listener {
        void touch(int action, int x, int y, float pressure);
    }

    private static final int NONE = -1;

    private final Listener listener;
    private int finger = NONE;
    private int lastX;
    private int lastY;

    FirstFinger(Listener listener) {
        this.listener = listener;
    }

    void follow(MotionEvent event) {
        switch (event.getActionMasked()) {
            case MotionEvent.ACTION_DOWN:
                finger = event.getPointerId(0);
                send(WaterHost.DOWN, event, 0);
                break;
            case MotionEvent.ACTION_MOVE:
                sendMoves(event);
                break;
            case MotionEvent.ACTION_POINTER_UP:
            case MotionEvent.ACTION_UP:
                if (event.getPointerId(event.getActionIndex()) == finger) {
                    send(WaterHost.UP, event, event.getActionIndex());
                    finger = NONE;
                }
                break;
            case MotionEvent.ACTION_CANCEL:
                end(WaterHost.CANCEL);
                break;
            default:  // further fingers, and what is no touch
        }
    }

    /** Ends a touch whose end will not be seen; the ink stays. */
    void lift() {
        end(WaterHost.UP);
    }

    private void end(int action) {
        if (finger == NONE) return;
        listener.touch(action, lastX, lastY, 0);
        finger = NONE;
    }

    // One event may hold several positions, the older ones as its history.
    private void sendMoves(MotionEvent event) {
        int index = event.findPointerIndex(finger);
        if (index < 0) return;
        for (int i = 0; i < event.getHistorySize(); ++i) {
            send(WaterHost.MOVE, event.getHistoricalX(index, i), event.getHistoricalY(index, i),
                    event.getHistoricalPressure(index, i));
        }
        send(WaterHost.MOVE, event, index);
    }

    private void send(int action, MotionEvent event, int index) {
        send(action, event.getX(index), event.getY(index), event.getPressure(index));
    }

    private void send(int action, float x, float y, float pressure) {
        lastX = Math.round(x);
        lastY = Math.round(y);
        listener.touch(action, lastX, lastY, pressure);
    }
}
