package com.zor.android.visualeffect.tidemark;

import android.view.MotionEvent;

/** Selects the touches of the finger that came down first. */
final class FirstFinger {
    interface Listener {
        /** Called with a position in pixels of the view and a time in milliseconds of the system's uptime. */
        void touch(int action, float x, float y, boolean isStylus, float pressure, long time);
    }

    private static final int NONE = -1;

    private final Listener listener;
    private int finger = NONE;
    private float lastX;
    private float lastY;
    private long lastTime;

    FirstFinger(Listener listener) {
        this.listener = listener;
    }

    void follow(MotionEvent event) {
        switch (event.getActionMasked()) {
            case MotionEvent.ACTION_DOWN:
                finger = event.getPointerId(0);
                send(MotionEvent.ACTION_DOWN, event, 0);
                break;
            case MotionEvent.ACTION_MOVE:
                sendMoves(event);
                break;
            case MotionEvent.ACTION_POINTER_UP:
            case MotionEvent.ACTION_UP:
                if (event.getPointerId(event.getActionIndex()) == finger) {
                    send(MotionEvent.ACTION_UP, event, event.getActionIndex());
                    finger = NONE;
                }
                break;
            case MotionEvent.ACTION_CANCEL:
                end(MotionEvent.ACTION_CANCEL);
                break;
            default:  // further fingers, and events without a touch
        }
    }

    /** Ends a touch whose remaining events will not be passed to {@link #follow}. The ink stays. */
    void lift() {
        end(MotionEvent.ACTION_UP);
    }

    private void end(int action) {
        if (finger == NONE) return;
        listener.touch(action, lastX, lastY, false, 0, lastTime);
        finger = NONE;
    }

    // An event may contain several positions. The older ones are its history.
    private void sendMoves(MotionEvent event) {
        int index = event.findPointerIndex(finger);
        if (index < 0) return;
        for (int i = 0; i < event.getHistorySize(); ++i) {
            listener.touch(MotionEvent.ACTION_MOVE, event.getHistoricalX(index, i), event.getHistoricalY(index, i),
                    isStylus(event, index), event.getHistoricalPressure(index, i), event.getHistoricalEventTime(i));
        }
        send(MotionEvent.ACTION_MOVE, event, index);
    }

    private void send(int action, MotionEvent event, int index) {
        lastX = event.getX(index);
        lastY = event.getY(index);
        lastTime = event.getEventTime();
        listener.touch(action, lastX, lastY, isStylus(event, index), event.getPressure(index), lastTime);
    }

    private static boolean isStylus(MotionEvent event, int index) {
        return event.getToolType(index) == MotionEvent.TOOL_TYPE_STYLUS;
    }
}
