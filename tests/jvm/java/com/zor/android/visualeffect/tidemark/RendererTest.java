package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import android.app.Activity;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.opengl.GLES20;
import android.os.SystemClock;
import android.view.MotionEvent;

import org.junit.After;
import org.junit.Before;
import org.junit.Test;

import java.util.Arrays;
import java.util.List;
import java.util.Vector;

/** The view and its renderer, from the touch to the screen: when they draw, when they rest, and what they show. */
public final class RendererTest {
    private static final int LONG = 160;
    private static final int SHORT = 90;
    private static final int RED = 0xffc04030;
    private static final int GREEN = 0xff40a050;

    private final Activity activity = new Activity();
    private final ViewOfAWindow view = new ViewOfAWindow(activity);
    private final ActivityFollower follower = new ActivityFollower(activity, view);
    private final Bitmap red = plain(Bitmap.Config.ARGB_8888, RED);
    private final Bitmap green = plain(Bitmap.Config.ARGB_8888, GREEN);
    private final Bitmap white = plain(Bitmap.Config.ARGB_8888, 0xffffffff);
    private final List<String> heard = new Vector<>();
    private int framesSeen = Screen.frames;
    private int handedOver = Bitmap.locksMade;

    @Before
    public void listen() {
        view.setListener(new TidemarkListener() {
            @Override
            public void onCalm() {
                heard.add("calm");
            }

            @Override
            public void onFailure(Failure failure, String message) {
                heard.add(failure.name());
            }
        });
    }

    @After
    public void release() {
        Screen.during(view, view::onDetachedFromWindow);
    }

    @Test
    public void drawsWhileSomethingMoves() {
        int cleared = GLES20.clears;
        surface(SHORT, LONG);
        assertEquals("frames without water", 1, drawUntilRest());
        view.setPictures(red, green, white);
        assertEquals("frames of still water", 1, drawUntilRest());
        assertEquals("frames of drawn water", 0, drawUntilRest());
        expectColor(RED);
        byte[] still = Screen.pixels;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_UP, 20, 40);
        drawFrame();
        assertTrue("a touch raises a wave", difference(still, Screen.pixels) > 30);
        long before = SystemClock.nanos;
        Screen.refreshRate = 240;
        drawFrame();
        Screen.refreshRate = 60;
        assertTrue("without ink no frame waits", SystemClock.nanos - before < 10000000);
        int frames = drawUntilRest();
        assertTrue(frames + " frames of waves", frames > 60 && frames < 480);
        assertTrue("water at rest looks as before", difference(still, Screen.pixels) <= 8);
        view.clearInk();
        Screen.isLost = true;
        assertEquals("frames where the first is lost with its context", 2, drawUntilRest());
        Screen.during(view, view::onStop);
        view.ripple(40, 40, 1);
        Screen.during(view, view::onStart);  // a wallpaper's surface lives on
        assertTrue("a splash of a pause is forgotten", drawUntilRest() < 3);
        assertEquals("frames without water", cleared + 1, GLES20.clears);
    }

    @Test
    public void inkShowsAndFadesAndComesBackAfterALostContext() {
        start();
        view.setInk(true);
        drawUntilRest();
        drawStroke();
        assertTrue("ink along a stroke", inked() > 100);

        view.setPreserveEGLContextOnPause(false);
        stop();
        drawUntilRest();
        view.clearInk();
        follower.onActivityStarted(new Activity());
        assertEquals("frames of a stopped activity", 0, drawUntilRest());
        restart();
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
    public void inkSurvivesAPauseThatKeepsTheContext() {
        start();
        view.setInk(true);
        drawUntilRest();
        drawStroke();
        stop();
        restart();
        assertTrue("ink goes on after a pause that kept the context", inked() > 100);
        view.setInk(false);
        view.setInk(true);
        drawFrame();
        assertEquals("a switch clears the ink", 0, inked());
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
        drawUntilRest();
        assertEquals("hand-overs after " + after, expected, Bitmap.locksMade - handedOver);
        handedOver = Bitmap.locksMade;
    }

    @Test
    public void aPictureOfTwoBytesAPixelIsConverted() {
        start();
        Bitmap narrow = plain(Bitmap.Config.RGB_565, 0xff102030);
        view.setPictures(narrow, narrow, narrow);
        drawUntilRest();
        expectColor(0xff102030);
    }

    @Test
    public void whatIsSetWhileTheViewIsAwayIsKept() {
        start();
        drawUntilRest();
        Screen.during(view, view::onDetachedFromWindow);
        view.setPictures(green, red, white);
        surface(LONG, SHORT);
        drawUntilRest();
        expectColor(RED);
    }

    @Test
    public void theNewestViewDraws() {
        start();
        view.setInk(true);
        drawUntilRest();
        TidemarkView newer = new TidemarkView(new Activity());
        newer.onStart();  // as a wallpaper does, which has no window
        newer.setPictures(green, green, white);
        newer.setInk(true);
        Screen.during(newer, () -> showSurface(newer, SHORT, LONG));
        expectColor(GREEN);
        framesSeen = Screen.frames;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("frames of an older view", 0, drawUntilRest());
        drawStroke(newer);
        Screen.during(view, () -> showSurface(view, SHORT, LONG));
        for (int i = 1; i <= 20; ++i) {
            touch(view, MotionEvent.ACTION_MOVE, 50 + i, 80 + 2 * i);
            drawFrame();
        }
        assertEquals("ink of the other view's stroke", 0, inked());
        Screen.during(newer, view::onStop);
        assertEquals("red of the other view, which goes on by itself", 0x40, Screen.pixels[0] & 255, 8);
        Screen.during(newer, newer::onDetachedFromWindow);
    }

    @Test
    public void aListenerHearsOfCalmAndFailures() {
        start();
        drawUntilRest();
        view.ripple(40, 40, 1);
        assertTrue("a splash moves", drawUntilRest() > 60);
        GLES20.largestTexture = 39;
        view.setPictures(green, green, white);
        drawUntilRest();
        GLES20.largestTexture = 2048;
        expectColor(RED);
        assertEquals(List.of("calm", "calm", "PICTURE_TOO_LARGE", "calm"), heard);
        assertThrows(IllegalArgumentException.class, () -> view.setPictures(red, null, white));
    }

    @Test
    public void aLookIsTakenAtAnyTime() {
        start();
        drawUntilRest();
        Look look = new Look();
        look.meshVertices = 64;
        look.stepsToRest = 5;
        view.setLook(look);
        look.meshVertices = 1;  // the view has its own copy
        assertEquals("frames of another mesh", 1, drawUntilRest());
        expectColor(RED);
    }

    @Test
    public void numbersBeyondAllMeasureLeaveTheWaterAlive() {
        start();
        drawUntilRest();
        byte[] still = Screen.pixels;
        for (float strength : new float[] {Float.NaN, 1e38f}) {
            view.ripple(40, 40, strength);
            drawUntilRest();
            assertTrue("waves of strength " + strength + " calm", difference(still, Screen.pixels) <= 20);
        }
        Look look = new Look();
        look.dropRadius = Float.NaN;
        view.setLook(look);
        view.ripple(40, 40, 1);
        drawFrame();
        drawFrame();
        assertTrue("a splash shows", difference(still, Screen.pixels) > 30);
        drawUntilRest();
        assertTrue("waves of a broken look calm", difference(still, Screen.pixels) <= 20);
    }

    @Test
    public void aLayoutSaysWhatTheViewShows() {
        start();
        ViewAttributes.apply(new TypedArray() {
            @Override
            public boolean getBoolean(int index, boolean usual) {
                return index == R.styleable.TidemarkView_ink;
            }
        }, view);
        drawUntilRest();
        drawStroke();
        assertTrue("ink of a layout", inked() > 100);
    }

    private static final class ViewOfAWindow extends TidemarkView {
        ViewOfAWindow(Activity activity) {
            super(activity);
        }

        void reattach() {
            onDetachedFromWindow();
            onAttachedToWindow();
        }
    }

    private void start() {
        surface(SHORT, LONG);
        view.setPictures(red, green, white);
    }

    // A first surface, or one after the view was out of its window, where its thread and its context end.
    private void surface(int width, int height) {
        Screen.during(view, () -> {
            view.reattach();
            showSurface(view, width, height);
        });
    }

    private static void showSurface(TidemarkView view, int width, int height) {
        Screen.width = width;
        Screen.height = height;
        view.surfaceCreated(null);
        view.surfaceChanged(null, 0, width, height);
    }

    private void resize(int width, int height) {
        Screen.during(view, () -> showSurface(view, width, height));
    }

    private void stop() {
        Screen.during(view, () -> {
            follower.onActivityStopped(activity);
            view.surfaceDestroyed(null);
        });
    }

    private void restart() {
        Screen.during(view, () -> {
            follower.onActivityStarted(activity);
            showSurface(view, Screen.width, Screen.height);
        });
    }

    private void touch(int action, float x, float y) {
        touch(view, action, x, y);
    }

    private static void touch(TidemarkView view, int action, float x, float y) {
        view.onTouchEvent(new MotionEvent(action, 0, new int[] {0}, new float[][][] {{{x, y, 1}}}));
    }

    // Slow, and the finger stays down.
    private void drawStroke() {
        drawStroke(view);
        framesSeen = Screen.frames;
    }

    private static void drawStroke(TidemarkView view) {
        touch(view, MotionEvent.ACTION_DOWN, 30, 40);
        for (int i = 1; i <= 20; ++i) {
            touch(view, MotionEvent.ACTION_MOVE, 30 + i, 40 + 2 * i);
            Screen.goOn(view);
        }
    }

    // Pixels darker than the background.
    private int inked() {
        byte[] pixels = Screen.pixels;
        int dark = 0;
        for (int i = 0; i < pixels.length; i += 4) {
            if ((pixels[i] & 255) < 150) ++dark;
        }
        return dark;
    }

    private void drawFrame() {
        Screen.goOn(view);
        framesSeen = Screen.frames;
    }

    private int drawUntilRest() {
        for (int i = 0; Screen.goOn(view) && i < 3000; ++i) continue;
        int frames = Screen.frames - framesSeen;
        framesSeen += frames;
        return frames;
    }

    private void expectColor(int argb) {
        int[] expected = {argb >> 16 & 255, argb >> 8 & 255, argb & 255};
        byte[] pixels = Screen.pixels;
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
