package com.zor.android.visualeffect.tidemark;

import android.view.MotionEvent;

import java.util.ArrayList;
import java.util.List;

/** What the water takes of the touches of several fingers. */
public final class FirstFingerTest {
    private static final int POINTER_DOWN = 5;
    private static final int HOVER_MOVE = 7;

    private final List<String> heard = new ArrayList<>();
    private final FirstFinger finger =
            new FirstFinger((action, x, y, pressure) -> heard.add(action + " " + x + " " + y + " " + pressure));

    public static void main(String[] arguments) {
        new FirstFingerTest().historyArrivesInOrder();
        new FirstFingerTest().otherFingersAreIgnored();
        new FirstFingerTest().theFirstFingerMayLeaveFirst();
        new FirstFingerTest().cancelComesOnceAndOnlyInATouch();
    }

    private void historyArrivesInOrder() {
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {7}, at(10.4f, 20.6f));
        float[][] path = {{11, 21, 0.1f}, {12, 22, 0.2f}, {13, 23, 0.3f}};
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {7}, path);
        follow(MotionEvent.ACTION_UP, 0, new int[] {7}, at(13, 23));
        expect("0 10 21 1.0", "2 11 21 0.1", "2 12 22 0.2", "2 13 23 0.3", "1 13 23 1.0");
    }

    private void otherFingersAreIgnored() {
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(1, 2));
        follow(POINTER_DOWN, 1, new int[] {0, 1}, at(1, 2), at(50, 60));
        // The first finger need not be the first of an event.
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {1, 0}, at(51, 61), at(3, 4));
        follow(MotionEvent.ACTION_POINTER_UP, 0, new int[] {1, 0}, at(51, 61), at(3, 4));
        follow(HOVER_MOVE, 0, new int[] {0}, at(9, 9));
        follow(MotionEvent.ACTION_UP, 0, new int[] {0}, at(3, 4));
        expect("0 1 2 1.0", "2 3 4 1.0", "1 3 4 1.0");
    }

    private void theFirstFingerMayLeaveFirst() {
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(1, 2));
        follow(POINTER_DOWN, 1, new int[] {0, 1}, at(1, 2), at(50, 60));
        follow(MotionEvent.ACTION_POINTER_UP, 0, new int[] {0, 1}, at(5, 6), at(50, 60));
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {1}, at(51, 61));
        follow(MotionEvent.ACTION_UP, 0, new int[] {1}, at(51, 61));
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(8, 9));
        expect("0 1 2 1.0", "1 5 6 1.0", "0 8 9 1.0");
    }

    private void cancelComesOnceAndOnlyInATouch() {
        finger.cancel();
        follow(MotionEvent.ACTION_DOWN, 0, new int[] {0}, at(1, 2));
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {0}, at(3, 4));
        finger.cancel();
        follow(MotionEvent.ACTION_CANCEL, 0, new int[] {0}, at(3, 4));
        follow(MotionEvent.ACTION_MOVE, 0, new int[] {0}, at(5, 6));
        expect("0 1 2 1.0", "2 3 4 1.0", "3 3 4 0.0");
    }

    private void follow(int action, int actionIndex, int[] ids, float[][]... positions) {
        finger.follow(new MotionEvent(action, actionIndex, ids, positions));
    }

    private static float[][] at(float x, float y) {
        return new float[][] {{x, y, 1}};
    }

    private void expect(String... events) {
        Check.equal(List.of(events), heard, "events");
    }
}
