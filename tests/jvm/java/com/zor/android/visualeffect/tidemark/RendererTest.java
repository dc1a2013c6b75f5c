package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertTrue;

import android.graphics.Bitmap;
import android.os.SystemClock;
import android.view.MotionEvent;

import org.junit.After;
import org.junit.Test;

import java.util.Arrays;

/** The view and its renderer, from the touch to the screen: when they draw, when they rest, and what they show. */
public final class RendererTest {
    private static final int LONG = 160;
    private static final int SHORT = 90;
    private static final int RED = 0xffc04030;
    private static final int GREEN = 0xff40a050;

    private final TidemarkView view = new TidemarkView(null);
    private final Bitmap red = plain(Bitmap.Config.ARGB_8888, RED);
    private final Bitmap green = plain(Bitmap.Config.ARGB_8888, GREEN);
    private final Bitmap white = plain(Bitmap.Config.ARGB_8888, 0xffffffff);
    private int width;
    private int height;

    @After
    public void release() {
        GlContext.release();
    }

    @Test
    public void drawsWhileSomethingMoves() {
        view.renderer.onDrawFrame(null);  // before there is anything to show
        start();
        assertEquals("frames of still water", 1, drawUntilRest());
        assertEquals("frames of drawn water", 0, drawUntilRest());
        expectColor(RED);
        byte[] still = GlContext.pixels(width, height);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_UP, 20, 40);
        drawFrame();
        assertTrue("a touch raises a wave", difference(still, GlContext.pixels(width, height)) > 30);
        long before = SystemClock.nanos;
        view.renderer.onDrawFrame(null);
        assertTrue("without ink no frame waits", SystemClock.nanos - before < 10000000);
        int frames = drawUntilRest();
        assertTrue(frames + " frames of waves", frames > 60 && frames < 480);
        assertTrue("water at rest looks as before", difference(still, GlContext.pixels(width, height)) <= 8);
    }

    @Test
    public void aRotationShowsTheOtherPicture() {
        start();
        drawUntilRest();
        surface(LONG, SHORT);
        assertEquals("frames after a rotation", 1, drawUntilRest());
        expectColor(GREEN);

        // A window that changes its size keeps its context.
        surface(LONG, LONG);
        resize(SHORT, SHORT);
        drawUntilRest();
        resize(LONG, SHORT);
        drawUntilRest();
        expectColor(GREEN);
        resize(SHORT, LONG);
        drawUntilRest();
        expectColor(RED);
    }

    @Test
    public void inkShowsAndFadesAndSurvivesAPause() {
        start();
        view.setInk(true);
        drawUntilRest();
        drawStroke();
        assertTrue("ink along a stroke", inked() > 100);

        view.onPause();
        runQueue();
        assertEquals("a pause ends the touch", 0, new JniTidemarkRender().getClearInkValue());
        surface(SHORT, LONG);
        view.onResume();
        touch(MotionEvent.ACTION_MOVE, 60, 100);
        assertTrue("ink that never rests", drawUntilRest() < 600);
        expectColor(RED);

        drawStroke();
        assertTrue("ink after a pause", inked() > 100);
        view.clearInk();
        drawFrame();
        assertEquals("ink after it was cleared", 0, inked());
        view.setInk(false);
        drawStroke();
        assertEquals("ink when it is off", 0, inked());
    }

    @Test
    public void onlyWhatIsNewIsHandedOver() {
        surface(LONG, LONG);
        resize(SHORT, LONG);
        expectHandOvers(0, "before there are pictures");
        view.setPictures(red, green, white);
        expectHandOvers(3, "the first pictures");
        view.setPictures(red, green, white);
        view.setInk(true);
        expectHandOvers(0, "ink");
        resize(LONG, SHORT);
        expectHandOvers(0, "a view turned");
        resize(SHORT, SHORT);
        expectHandOvers(2, "a view of other proportions");
        surface(SHORT, SHORT);
        expectHandOvers(0, "a lost context");
        view.setPictures(red, red, white);
        expectHandOvers(1, "another picture");
    }

    private void expectHandOvers(int expected, String after) {
        int before = Bitmap.locksMade;
        drawUntilRest();
        assertEquals("hand-overs after " + after, expected, Bitmap.locksMade - before);
    }

    @Test
    public void aPictureOfTwoBytesAPixelIsConverted() {
        start();
        Bitmap narrow = plain(Bitmap.Config.RGB_565, 0xff102030);
        view.setPictures(narrow, narrow, narrow);
        drawUntilRest();
        expectColor(0xff102030);
    }

    private void start() {
        surface(SHORT, LONG);
        view.setPictures(red, green, white);
    }

    private void surface(int width, int height) {
        GlContext.open(width, height);
        view.renderer.onSurfaceCreated(null, null);
        resize(width, height);
    }

    private void resize(int width, int height) {
        this.width = width;
        this.height = height;
        view.renderer.onSurfaceChanged(null, width, height);
        view.renderRequested = true;  // as GLSurfaceView does for a new surface
    }

    private void touch(int action, float x, float y) {
        view.onTouchEvent(new MotionEvent(action, 0, new int[] {0}, new float[][][] {{{x, y, 1}}}));
    }

    // Slow, and the finger stays down.
    private void drawStroke() {
        touch(MotionEvent.ACTION_DOWN, 30, 40);
        for (int i = 1; i <= 20; ++i) {
            touch(MotionEvent.ACTION_MOVE, 30 + i, 40 + 2 * i);
            drawFrame();
        }
    }

    // Pixels darker than the background.
    private int inked() {
        byte[] pixels = GlContext.pixels(width, height);
        int dark = 0;
        for (int i = 0; i < pixels.length; i += 4) {
            if ((pixels[i] & 255) < 150) ++dark;
        }
        return dark;
    }

    private void runQueue() {
        while (!view.queue.isEmpty()) view.queue.remove().run();
    }

    private void drawFrame() {
        runQueue();
        view.renderRequested = false;
        SystemClock.nanos += 1000000000 / 60;
        view.renderer.onDrawFrame(null);
    }

    private int drawUntilRest() {
        runQueue();
        int frames = 0;
        for (; view.renderRequested && frames < 3000; ++frames) drawFrame();
        return frames;
    }

    private void expectColor(int argb) {
        int[] expected = {argb >> 16 & 255, argb >> 8 & 255, argb & 255};
        byte[] pixels = GlContext.pixels(width, height);
        for (int i = 0; i < pixels.length; ++i) {
            if (i % 4 == 3) continue;
            assertTrue((pixels[i] & 255) + " at byte " + i, Math.abs((pixels[i] & 255) - expected[i % 4]) <= 8);
        }
    }

    private static int difference(byte[] one, byte[] other) {
        int most = 0;
        for (int i = 0; i < one.length; ++i) most = Math.max(most, Math.abs((one[i] & 255) - (other[i] & 255)));
        return most;
    }

    private static Bitmap plain(Bitmap.Config config, int argb) {
        int[] colors = new int[40 * 40];
        Arrays.fill(colors, argb);
        return Bitmap.createBitmap(colors, 40, 40, config);
    }
}
