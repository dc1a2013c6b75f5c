package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertNull;
import static org.junit.Assert.assertTrue;

import android.content.ComponentCallbacks2;
import android.view.MotionEvent;

import org.junit.Test;

import java.util.List;

/** Views share one library and one context: which of them draws, and what is freed if none does. */
public final class SharedLibraryTest extends ViewFixture {
    @Test
    public void theNewestViewWithAPictureDraws() {
        start();
        view.setInk(true);
        view.setListener(new RecordingListener());
        drawUntilCalm();
        TestView newer = new TestView();
        show(newer, SHORT, LONG);
        view.drop(40, 40);
        assertTrue("the older view still draws", drawUntilCalm() > 60);
        newer.setPictures(green, green, null);
        drawUntilCalm();
        expectColor(GREEN);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("frames of an older view", 0, drawUntilCalm());
        assertNull(view.toBitmap());
        newer.setInk(true);
        drawStroke(newer);
        show(view, SHORT, LONG);
        for (int i = 1; i <= 20; ++i) {
            touch(MotionEvent.ACTION_MOVE, 50 + i, 80 + 2 * i);
            drawFrame();
        }
        assertEquals("ink of the other view's stroke", 0, inkedPixels());
        drawUntilCalm();
        expectColor(RED);
        assertEquals(List.of("ready", "calm", "wake", "calm", "rest", "calm"), calls.subList(0, 6));
        newer.setInk(false);
        hide(view);
        drawUntilCalm();
        assertEquals("red of the other view, which draws again", 0x40, Screen.pixels[0] & 255, 8);

        int[] objects = new int[8];
        for (int turn = 0; turn < 8; ++turn) {
            show(turn % 2 == 0 ? view : newer, SHORT, LONG);
            drawUntilCalm();
            int at = turn;
            GlThread.await(() -> objects[at] = GlContext.countObjects());
        }
        assertEquals("GL objects after more turns", objects[1], objects[7]);
        hide(newer);
        drawUntilCalm();
        expectColor(RED);
        newer.onDetachedFromWindow();
    }

    @Test
    public void memoryIsFreedIfNoViewDraws() {
        start();
        drawUntilCalm();
        Screen.process.onTrimMemory(ComponentCallbacks2.TRIM_MEMORY_BACKGROUND);
        expectTransfers(3, "a call to trim while a view draws");
        hide(view);
        Screen.process.onTrimMemory(ComponentCallbacks2.TRIM_MEMORY_BACKGROUND - 20);
        expectTransfers(0, "a call of a low level");
        Screen.process.onTrimMemory(ComponentCallbacks2.TRIM_MEMORY_BACKGROUND);
        expectTransfers(3, "a call to trim, which transfers single pixels");
        show(view, SHORT, LONG);
        expectTransfers(3, "the view is visible again");
        expectColor(RED);
    }
}
