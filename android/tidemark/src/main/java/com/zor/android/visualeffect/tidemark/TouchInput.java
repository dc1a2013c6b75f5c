package com.zor.android.visualeffect.tidemark;

import android.view.GestureDetector;
import android.view.MotionEvent;

/** Passes the touches of a view's first finger to its water, and finds clicks in them. Used on the main thread. */
final class TouchInput extends GestureDetector.SimpleOnGestureListener {
    Interaction interaction = Interaction.PRESS;

    private final TidemarkView view;
    private final FirstFinger finger;
    private final GestureDetector gestures;

    TouchInput(TidemarkView view, FirstFinger.Listener water) {
        this.view = view;
        finger = new FirstFinger(water);
        gestures = new GestureDetector(view.getContext(), this);
    }

    /** Returns false, and does nothing, if touches have no effect. */
    boolean follow(MotionEvent event) {
        if (interaction == Interaction.NONE) return false;
        finger.follow(event);
        gestures.onTouchEvent(event);
        boolean isDown = event.getActionMasked() == MotionEvent.ACTION_DOWN;
        if (isDown && interaction == Interaction.PRESS) view.claimFinger();
        return true;
    }

    /** Ends the current touch. */
    void lift() {
        finger.lift();
    }

    @Override
    public boolean onSingleTapUp(MotionEvent event) {
        return view.performClick();
    }

    @Override
    public void onLongPress(MotionEvent event) {
        view.performLongClick();
    }
}
