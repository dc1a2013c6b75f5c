package android.view;

import android.os.SystemClock;

/** A touch event of a test. Its positions are indexed by finger and time; the last one is current. */
public final class MotionEvent {
    public static final int ACTION_DOWN = 0;
    public static final int ACTION_UP = 1;
    public static final int ACTION_MOVE = 2;
    public static final int ACTION_CANCEL = 3;
    public static final int ACTION_POINTER_DOWN = 5;
    public static final int ACTION_POINTER_UP = 6;
    public static final int ACTION_HOVER_MOVE = 7;
    public static final int TOOL_TYPE_FINGER = 1;
    public static final int TOOL_TYPE_STYLUS = 2;

    /** The tool of all fingers. */
    public int toolType = TOOL_TYPE_FINGER;

    private final int action;
    private final int actionIndex;
    private final int[] ids;
    private final float[][][] xyPressure;

    public MotionEvent(int action, int actionIndex, int[] ids, float[][][] xyPressure) {
        this.action = action;
        this.actionIndex = actionIndex;
        this.ids = ids;
        this.xyPressure = xyPressure;
    }

    public int getActionMasked() {
        return action;
    }

    public int getActionIndex() {
        return actionIndex;
    }

    public int getPointerId(int index) {
        return ids[index];
    }

    public int findPointerIndex(int id) {
        for (int i = 0; i < ids.length; ++i) {
            if (ids[i] == id) return i;
        }
        return -1;
    }

    public int getHistorySize() {
        return xyPressure[0].length - 1;
    }

    public float getX(int index) {
        return getHistoricalX(index, getHistorySize());
    }

    public float getY(int index) {
        return getHistoricalY(index, getHistorySize());
    }

    public float getPressure(int index) {
        return getHistoricalPressure(index, getHistorySize());
    }

    public float getHistoricalX(int index, int position) {
        return xyPressure[index][position][0];
    }

    public float getHistoricalY(int index, int position) {
        return xyPressure[index][position][1];
    }

    public float getHistoricalPressure(int index, int position) {
        return xyPressure[index][position][2];
    }

    public int getToolType(int index) {
        return toolType;
    }

    public long getEventTime() {
        return getHistoricalEventTime(getHistorySize());
    }

    /** Each position is a millisecond later than the one before. */
    public long getHistoricalEventTime(int position) {
        return SystemClock.uptimeMillis() + position;
    }
}
