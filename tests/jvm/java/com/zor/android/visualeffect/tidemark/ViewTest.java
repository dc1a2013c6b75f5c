package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import android.app.Activity;
import android.content.res.Resources;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.opengl.GLES20;
import android.os.SystemClock;
import android.util.DisplayMetrics;
import android.view.MotionEvent;
import android.view.SurfaceHolder;

import org.junit.After;
import org.junit.Before;
import org.junit.Test;

import java.lang.reflect.Proxy;
import java.util.Arrays;
import java.util.List;
import java.util.Vector;

/** The view and its renderer, from the touch to the screen: when they draw, when they rest, and what they show. */
public final class RendererTest {
    private static final int LONG = 160;
    private static final int SHORT = 90;
    private static final int RED = 0xffc04030;
    private static final int GREEN = 0xff40a050;

    private final Activity activity = new Activity() {
        @Override
        public Resources getResources() {
            return new Resources(null, null, null) {
                @Override
                public DisplayMetrics getDisplayMetrics() {
                    DisplayMetrics display = new DisplayMetrics();
                    display.density = 2;
                    return display;
                }
            };
        }
    };
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
        for (int i = 0; i < 8; ++i) drawFrame();
        assertTrue("a touch raises a wave", difference(still, Screen.pixels) > 30);
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
        long before = SystemClock.nanos;
        Screen.refreshRate = 240;
        drawStroke();
        Screen.refreshRate = 60;
        assertTrue("ink along a stroke", inked() > 100);
        assertTrue("20 frames take the time of 20 steps of the ink", SystemClock.nanos - before > 250000000);

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
        int cleared = GLES20.clears;
        restart();
        assertTrue("ink goes on after a pause that kept the context", inked() > 100);
        assertEquals("blank frames, as no step of the ink is due", cleared, GLES20.clears);
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
    public void aLargePictureIsCroppedAndEveryPixelCounts() {
        int[] colors = new int[500 * 640];
        for (int i = 0; i < colors.length; ++i) {  // a chessboard between red margins
            int x = i % 500;
            colors[i] = x < 70 || x >= 430 ? RED : (x / 2 + i / 1000) % 2 == 0 ? 0xff000000 : 0xffffffff;
        }
        Bitmap board = Bitmap.createBitmap(colors, 500, 640, Bitmap.Config.ARGB_8888);
        Bitmap fitted = new Pictures(board, board, board).fitted(0, SHORT, LONG);
        assertEquals(SHORT + " x " + LONG, fitted.getWidth() + " x " + fitted.getHeight());
        for (int i = 0; i < fitted.pixels.capacity(); i += 4) assertEquals(127, fitted.pixels.get(i) & 255, 1);
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
        while (Screen.goOn(newer)) continue;
        framesSeen = Screen.frames;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("frames of an older view", 0, drawUntilRest());

        drawStroke(newer);
        Screen.during(view, () -> showSurface(view, SHORT, LONG));
        for (int i = 1; i <= 20; ++i) {
            touch(MotionEvent.ACTION_MOVE, 50 + i, 80 + 2 * i);
            drawFrame();
        }
        assertEquals("ink of the other view's stroke", 0, inked());
        Screen.during(view, view::onStop);
        assertTrue("the other view goes on by itself", Screen.goOn(newer));
        assertEquals("its red", 0x40, Screen.pixels[0] & 255, 8);
        Screen.during(newer, newer::onDetachedFromWindow);
    }

    @Test
    public void theSurfaceHasTheSizeOfTheQuality() {
        start();
        drawUntilRest();
        int cleared = GLES20.clears;
        view.setQuality(Quality.LOW);
        view.onSizeChanged(LONG, LONG, 0, 0);  // on a display of two pixels each
        drawUntilRest();
        assertEquals("80 x 80", view.sizeSet);
        assertEquals("blank frames until the surface is another", cleared, GLES20.clears);
        resize(80, 80);
        drawUntilRest();
        expectColor(RED);
        byte[] still = Screen.pixels;
        touch(MotionEvent.ACTION_DOWN, LONG / 2, LONG / 4);
        for (int i = 0; i < 8; ++i) drawFrame();
        assertTrue("a touch is where it is in the view", difference(rowOf(still), rowOf(Screen.pixels)) > 30);
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
        look.dropRadius = Float.NaN;  // the view has its own copy
        assertEquals("frames of another mesh", 1, drawUntilRest());
        String message = assertThrows(IllegalArgumentException.class, () -> view.setLook(look)).getMessage();
        assertTrue(message, message.contains("dropRadius"));
        assertEquals("frames of a look that is refused", 0, drawUntilRest());
        expectColor(RED);
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
        String sizeSet;

        ViewOfAWindow(Activity activity) {
            super(activity);
        }

        @Override
        public SurfaceHolder getHolder() {
            return (SurfaceHolder) Proxy.newProxyInstance(getClass().getClassLoader(),
                    new Class<?>[] {SurfaceHolder.class}, (self, method, values) -> {
                        if (method.getName().equals("setFixedSize")) sizeSet = values[0] + " x " + values[1];
                        return null;
                    });
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

    // A quarter of the way down.
    private static byte[] rowOf(byte[] pixels) {
        int row = pixels.length / Screen.height;
        return Arrays.copyOfRange(pixels, Screen.height * 3 / 4 * row, (Screen.height * 3 / 4 + 1) * row);
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
