package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertTrue;

import android.graphics.SurfaceTexture;
import android.os.SystemClock;
import android.view.MotionEvent;
import android.view.SurfaceView;

import org.junit.Test;

import java.util.Arrays;
import java.util.List;

/** When a view draws, and on which surface. */
public final class DrawingTest extends ViewFixture {
    @Test
    public void drawsWhileSomethingMoves() {
        view.setListener(new RecordingListener());
        show(view, SHORT, LONG);
        assertEquals("frames without a picture", 0, drawUntilCalm());
        view.setPicture(RED);
        assertEquals("frames of still water", 1, drawUntilCalm());
        assertEquals("frames without a change", 0, drawUntilCalm());
        expectColor(RED);
        byte[] still = Screen.pixels;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_UP, 20, 40);
        for (int i = 0; i < 8; ++i) drawFrame();
        assertTrue("a touch raises a wave", difference(still, Screen.pixels) > 30);
        int frames = drawUntilCalm();
        assertTrue(frames + " frames of waves", frames > 60 && frames < 480);
        assertTrue("calm water looks as before", difference(still, Screen.pixels) <= 8);
        view.clearInk();
        Screen.isLost = true;
        assertEquals("frames, the first of which loses its context", 2, drawUntilCalm());
        expectColor(RED);
        hide(view);
        view.drop(40, 40);
        show(view, SHORT, LONG);
        assertTrue("a hidden view ignores a drop", drawUntilCalm() < 3);
        assertEquals(List.of("ready", "calm", "wake", "calm"), calls);
    }

    @Test
    public void inkShowsAndFadesAndRemainsWhileTheViewIsHidden() {
        start();
        view.setInk(true);
        drawUntilCalm();
        long before = SystemClock.nanos;
        Screen.refreshRate = 240;
        drawStroke(view);
        Screen.refreshRate = 60;
        assertTrue("ink along a stroke", inkedPixels() > 100);
        assertTrue("20 frames take the time of 20 steps of the ink", SystemClock.nanos - before > 250000000);
        hide(view);
        assertEquals("frames of a hidden view", 0, drawUntilCalm());
        show(view, SHORT, LONG);
        drawFrame();
        assertTrue("the ink remains", inkedPixels() > 100);
        assertTrue("the ink fades", drawUntilCalm() < 600);
        expectColor(RED);

        drawStroke(view);
        view.clearInk();
        drawFrame();
        assertEquals("ink after clearInk", 0, inkedPixels());
        drawStroke(view);
        view.setInk(false);
        drawFrame();
        view.setInk(true);
        drawFrame();
        assertEquals("ink after it was off", 0, inkedPixels());
    }

    @Test
    public void theSurfaceHasTheSizeOfTheQuality() {
        start();
        drawUntilCalm();
        view.setQuality(Quality.LOW);
        view.onSizeChanged(LONG, LONG, 0, 0);
        drawUntilCalm();
        assertEquals("80 x 80", SurfaceView.sizeSet);
        Screen.width = Screen.height = 80;
        view.drawOn(view.surface, 80, 80);
        view.onSizeChanged(LONG, LONG, 0, 0);
        drawUntilCalm();
        expectColor(RED);
        byte[] still = Screen.pixels;
        touch(MotionEvent.ACTION_DOWN, LONG / 2, LONG / 4);
        for (int i = 0; i < 8; ++i) drawFrame();
        assertTrue("a wave at the place of the touch", difference(upperRow(still), upperRow(Screen.pixels)) > 30);
        touch(MotionEvent.ACTION_UP, LONG / 2, LONG / 4);
        view.pause();
        view.onSizeChanged(LONG, SHORT, LONG, LONG);
        drawUntilCalm();
        assertEquals("in a pause", "80 x 64", SurfaceView.sizeSet);
    }

    // The row a quarter of the way down.
    private static byte[] upperRow(byte[] pixels) {
        int row = pixels.length / Screen.height;
        return Arrays.copyOfRange(pixels, Screen.height * 3 / 4 * row, (Screen.height * 3 / 4 + 1) * row);
    }

    @Test
    public void aTextureIsUsedWhileItIsVisible() {
        SurfaceTexture texture = new SurfaceTexture(0);
        WaterSurface surface = new WaterSurface(new TestActivity(), true,
                (window, width, height) -> calls.add(window == texture ? width + " x " + height : "none"));
        surface.setVisible(true);
        surface.onSurfaceTextureAvailable(texture, SHORT, LONG);
        surface.setSize(60, 80);
        surface.onSurfaceTextureSizeChanged(texture, LONG, LONG);
        surface.setVisible(false);
        surface.setVisible(true);
        surface.onSurfaceTextureDestroyed(texture);
        surface.setSize(30, 40);
        assertEquals(List.of("90 x 160", "60 x 80", "none", "60 x 80", "none"), calls);
    }
}
