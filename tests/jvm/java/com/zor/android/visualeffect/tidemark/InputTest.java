package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import android.graphics.Bitmap;
import android.view.MotionEvent;

import org.junit.Test;

/** Touches, and calls that move the water or stop it. */
public final class InputTest extends ViewFixture {
    @Test
    public void codeMovesTheWaterAsAFingerDoes() {
        start();
        view.setInk(true);
        drawUntilCalm();
        view.stroke(new float[] {30, 40, 50, 80, 60, 120}, 400);
        for (int i = 0; i < 40; ++i) drawFrame();
        assertTrue("ink of a stroke", inkedPixels() > 100);
        Bitmap picture = view.toBitmap();  // draws another frame
        int shown = Screen.pixels[4 * SHORT * 20] & 255;
        assertEquals("the bitmap is upright", shown, picture.pixels.get(4 * SHORT * (LONG - 21)) & 255);

        drawFrame();
        view.pause();
        drawUntilCalm();
        assertEquals("frames in a pause", 0, drawUntilCalm());
        view.play();
        drawFrame();
        assertTrue("the water moves after a pause", drawUntilCalm() > 60);
        assertThrows(IllegalArgumentException.class, () -> view.stroke(new float[] {1}, 400));
    }

    @Test
    public void dropsWaitForTheFirstFrame() {
        TestView other = new TestView();
        for (TestView each : new TestView[] {view, other}) {
            if (each == view) each.drop(SHORT / 2, LONG / 2);  // before the first surface
            show(each, SHORT, LONG);
            each.setPicture(RED);
            if (each == other) each.drop(SHORT / 2, LONG / 2);  // before the first picture
            for (int i = 0; i < 8; ++i) drawFrame();
            byte[] waves = Screen.pixels;
            drawUntilCalm();
            assertTrue("waves of the drop", difference(waves, Screen.pixels) > 30);
        }
        other.onDetachedFromWindow();
    }

    @Test
    public void touchesAreUsedIfThereIsWater() {
        show(view, SHORT, LONG);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        view.setPicture(RED);
        drawUntilCalm();
        assertEquals("claims without a picture", 0, view.claims);
        view.setInteraction(Interaction.PRESS_OR_SCROLL);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_CANCEL, 20, 40);
        assertEquals("claims if a list may scroll", 0, view.claims);
        assertTrue("ripples if a list may scroll", drawUntilCalm() > 60);
        view.setInteraction(Interaction.NONE);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        view.setInteraction(Interaction.PRESS);
        view.isEnabled = false;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("frames after touches that are ignored", 0, drawUntilCalm());
        view.isEnabled = true;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("claims of a finger that moves the water", 1, view.claims);
    }
}
