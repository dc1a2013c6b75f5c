package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;
import android.view.MotionEvent;

import java.util.Arrays;

/** The view and its renderer, from the touch to the screen: when they draw, when they rest, and what they show. */
public final class RendererTest {
    private static final int LONG = 160;
    private static final int SHORT = 90;
    private static final int RED = 0xffc04030;
    private static final int GREEN = 0xff40a050;

    private final TidemarkView view = new TidemarkView(null);
    private int width;
    private int height;
    private long now;

    public static void main(String[] arguments) {
        new RendererTest().stillWaterIsDrawnOnce();
        for (int framesPerSecond : new int[] {30, 90}) new RendererTest().wavesAreDrawnToTheirEnd(framesPerSecond);
        new RendererTest().aRotationShowsTheOtherPicture();
        new RendererTest().inkShowsAndFadesAndSurvivesAPause();
        new RendererTest().aPictureOfTwoBytesAPixelIsConverted();
        theClockBringsWholeStepsAndHoldsFastDisplaysBack();
        GlContext.release();
    }

    private void stillWaterIsDrawnOnce() {
        view.renderer.onDrawFrame(null);  // before there is anything to show
        start();
        Check.equal(1, drawUntilRest(60), "frames of still water");
        Check.equal(0, drawUntilRest(60), "frames of drawn water");
        expectColor(RED);
    }

    private void wavesAreDrawnToTheirEnd(int framesPerSecond) {
        start();
        drawUntilRest(framesPerSecond);
        byte[] still = GlContext.pixels(width, height);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_UP, 20, 40);
        drawFrame(framesPerSecond);
        Check.that(difference(still, GlContext.pixels(width, height)) > 30, "a touch raises a wave");
        double seconds = (double) drawUntilRest(framesPerSecond) / framesPerSecond;
        Check.that(seconds > 1 && seconds < 8, "waves of " + seconds + " s at " + framesPerSecond + " Hz");
        Check.that(difference(still, GlContext.pixels(width, height)) <= 8, "water at rest looks as before");
    }

    private void aRotationShowsTheOtherPicture() {
        start();
        drawUntilRest(60);
        surface(LONG, SHORT);
        Check.equal(1, drawUntilRest(60), "frames after a rotation");
        expectColor(GREEN);

        // A window that changes its size keeps its context.
        surface(LONG, LONG);
        resize(SHORT, SHORT);
        drawUntilRest(60);
        resize(LONG, SHORT);
        drawUntilRest(60);
        expectColor(GREEN);
        resize(SHORT, LONG);
        drawUntilRest(60);
        expectColor(RED);
    }

    private void inkShowsAndFadesAndSurvivesAPause() {
        start();
        view.setInk(true);
        drawUntilRest(60);
        drawStroke();
        Check.that(inked() > 100, "ink along a stroke");

        view.onPause();
        runQueue();
        Check.equal(0, new JniTidemarkRender().getClearInkValue(), "a pause ends the touch");
        surface(SHORT, LONG);
        view.onResume();
        touch(MotionEvent.ACTION_MOVE, 60, 100);
        int frames = drawUntilRest(60);
        Check.that(frames < 600, "ink that never rests");
        expectColor(RED);

        drawStroke();
        Check.that(inked() > 100, "ink after a pause");
        view.clearInk();
        drawFrame(60);
        Check.equal(0, inked(), "ink after it was cleared");
        view.setInk(false);
        drawStroke();
        Check.equal(0, inked(), "ink when it is off");

        view.setInk(true);
        drawStroke();
        view.setInk(false);
        view.setInk(true);
        touch(MotionEvent.ACTION_DOWN, 60, 130);
        drawFrame(60);
        Check.equal(0, inked(), "a stroke from where the finger was when the ink was switched off");
    }

    private void aPictureOfTwoBytesAPixelIsConverted() {
        start();
        Bitmap narrow = plain(Bitmap.Config.RGB_565, 0xff102030);
        view.setPictures(narrow, narrow, narrow);
        drawUntilRest(60);
        expectColor(0xff102030);
    }

    private static void theClockBringsWholeStepsAndHoldsFastDisplaysBack() {
        FrameClock clock = new FrameClock(60);
        long frame = 16683350;  // of a display of 59.94 Hz
        for (int i = 0; i < 100; ++i) {
            double steps = 60 * clock.secondsUntil(i * frame + (i % 7) * 500000);
            Check.that(Math.abs(steps - 1) < 1.0e-9, "steps of a frame of about one step");
        }
        clock = new FrameClock(60);
        Check.equal(0L, clock.nanosToWait(0), "wait for the first frame");
        clock.secondsUntil(0);
        Check.that(clock.nanosToWait(8333333) > 0, "a display of 120 Hz leaves every second frame out");
        Check.equal(0L, clock.nanosToWait(11111111), "wait on a display of 90 Hz");
        Check.that(Math.abs(clock.secondsUntil(100000000) - 0.1) < 1.0e-9, "a late frame brings its time");
        clock.rest();
        Check.that(clock.secondsUntil(9000000000L) < 0.02, "no time passes at rest");
    }

    private void start() {
        surface(SHORT, LONG);
        view.setPictures(plain(Bitmap.Config.ARGB_8888, RED), plain(Bitmap.Config.ARGB_8888, GREEN),
                plain(Bitmap.Config.ARGB_8888, 0xffffffff));
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
            drawFrame(60);
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

    private void drawFrame(int framesPerSecond) {
        runQueue();
        view.renderRequested = false;
        now += 1000000000L / framesPerSecond;
        view.renderer.drawFrame(now);
    }

    private int drawUntilRest(int framesPerSecond) {
        runQueue();
        int frames = 0;
        for (; view.renderRequested && frames < 3000; ++frames) drawFrame(framesPerSecond);
        return frames;
    }

    private int[] pixel(int x, int y) {
        byte[] pixels = GlContext.pixels(width, height);
        int i = 4 * ((height - 1 - y) * width + x);
        return new int[] {pixels[i] & 255, pixels[i + 1] & 255, pixels[i + 2] & 255};
    }

    private void expectColor(int argb) {
        int[] expected = {argb >> 16 & 255, argb >> 8 & 255, argb & 255};
        for (int x = 1; x < width; x += 13) {
            for (int y = 1; y < height; y += 13) {
                int[] actual = pixel(x, y);
                for (int c = 0; c < 3; ++c) {
                    Check.that(Math.abs(actual[c] - expected[c]) <= 8, Arrays.toString(actual) + " at " + x + ", " + y);
                }
            }
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
