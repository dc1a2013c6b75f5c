package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;

import android.os.SystemClock;
import android.view.MotionEvent;

import org.junit.Before;
import org.junit.Test;

import java.util.ArrayList;
import java.util.List;

/** The touches of the first of several fingers. */
public final class FirstFingerTest {
    private final List<String> touches = new ArrayList<>();
    private final FirstFinger finger =
            new FirstFinger((action, x, y, isStylus, pressure, time) -> touches.add(
                    action + " " + x + " " + y + (isStylus ? " pen " : " ") + pressure + " " + time));

    @Before
    public void resetClock() {
        SystemClock.nanos = 0;
    }

    @Test
    public void historyArrivesInOrder() {
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {7}, at(10.4f, 20.6f));
        float[][] path = {{11, 21, 0.1f}, {12, 22, 0.2f}, {13, 23, 0.3f}};
        MotionEvent moves = new MotionEvent(MotionEvent.ACTION_MOVE, 0, new int[] {7}, new float[][][] {path});
        moves.toolType = MotionEvent.TOOL_TYPE_STYLUS;
        finger.follow(moves);
        follow(MotionEvent.ACTION_UP, 0, new int[] {7}, at(13, 23));
        assertEquals(List.of("0 10.4 20.6 1.0 0", "2 11.0 21.0 pen 0.1 0", "2 12.0 22.0 pen 0.2 1",
                "2 13.0 23.0 pen 0.3 2", "1 13.0 23.0 1.0 0"), touches);
    }

    @Test
    public void otherFingersAreIgnored() {
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(1, 2));
        follow(MotionEvent.ACTION_POINTER_DOWN, 1, new int[] {0, 1}, at(1, 2), at(50, 60));
        // The first finger may have any index in an event, and may be lifted before the others.
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {1, 0}, at(51, 61), at(3, 4));
        follow(MotionEvent.ACTION_POINTER_UP, 0, new int[] {1, 0}, at(51, 61), at(3, 4));
        follow(MotionEvent.ACTION_HOVER_MOVE, 0, new int[] {0}, at(9, 9));
        follow(MotionEvent.ACTION_POINTER_UP, 1, new int[] {1, 0}, at(52, 62), at(5, 6));
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {1}, at(53, 63));
        follow(MotionEvent.ACTION_UP, 0, new int[] {1}, at(53, 63));
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(8, 9));
        assertEquals(List.of("0 1.0 2.0 1.0 0", "2 3.0 4.0 1.0 0", "1 5.0 6.0 1.0 0", "0 8.0 9.0 1.0 0"), touches);
    }

    @Test
    public void aTouchEndsOnce() {
        finger.lift();
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(1, 2));
        finger.lift();
        follow(MotionEvent.ACTION_CANCEL, 0, new int[] {0}, at(3, 4));
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {0}, at(5, 6));
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(1, 2));
        follow(MotionEvent.ACTION_CANCEL, 0, new int[] {0}, at(3, 4));
        finger.lift();
        assertEquals(List.of("0 1.0 2.0 1.0 0", "1 1.0 2.0 0.0 0", "0 1.0 2.0 1.0 0", "3 1.0 2.0 0.0 0"), touches);
    }

    private void follow(int action, int actionIndex, int[] ids, float[][]... positions) {
        finger.follow(new MotionEvent(action, actionIndex, ids, positions));
    }

    private static float[][] at(float x, float y) {
        return new float[][] {{x, y, 1}};
    }
}
