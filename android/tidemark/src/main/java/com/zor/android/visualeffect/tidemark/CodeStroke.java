package com.zor.android.visualeffect.tidemark;

import android.view.MotionEvent;

/** A stroke that the app's code draws: touches along a line through points, with the same time for each part. */
final class CodeStroke {
    private final float[] shares;  // x and y of each point, as shares of the view's sides
    private final double start;
    private final double seconds;
    private int action = MotionEvent.ACTION_DOWN;

    CodeStroke(float[] shares, double start, double seconds) {
        this.shares = shares;
        this.start = start;
        this.seconds = seconds;
    }

    /** Touches the water at the place of the time {@code now}. Returns false after the last point. */
    boolean follow(NativeWater water, double now) {
        int last = shares.length / 2 - 1;
        double at = action == MotionEvent.ACTION_DOWN ? 0 : Math.min((now - start) / seconds, 1) * last;
        int i = 2 * Math.min((int) at, Math.max(last - 1, 0));
        int j = Math.min(i + 2, 2 * last);
        float share = (float) (at - i / 2);
        float x = shares[i] + share * (shares[j] - shares[i]);
        float y = shares[i + 1] + share * (shares[j + 1] - shares[i + 1]);
        water.touch(action, x, y, false, 1, now);
        if (at >= last && action == MotionEvent.ACTION_MOVE) {
            water.touch(MotionEvent.ACTION_UP, x, y, false, 1, now);
            return false;
        }
        action = MotionEvent.ACTION_MOVE;
        return true;
    }
}
