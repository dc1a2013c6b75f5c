package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;
import android.opengl.GLES20;
import android.os.SystemClock;
import android.view.MotionEvent;

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

    public static void main(String[] arguments) {
        new RendererTest().drawsWhileSomethingMoves();
        new RendererTest().aRotationShowsTheOtherPicture();
        new RendererTest().inkShowsAndFadesAndSurvivesAPause();
        new RendererTest().onlyWhatIsNewIsHandedOver();
        new RendererTest().aPictureOfTwoBytesAPixelIsConverted();
        GlContext.release();
    }

    private void drawsWhileSomethingMoves() {
        view.renderer.onDrawFrame(null);  // before there is anything to show
        start();
        Check.equal(1, drawUntilRest(), "frames of still water");
        Check.equal(0, drawUntilRest(), "frames of drawn water");
        expectColor(RED);
        byte[] still = GlContext.pixels(width, height);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_UP, 20, 40);
        drawFrame();
        Check.that(difference(still, GlContext.pixels(width, height)) > 30, "a touch raises a wave");
        long before = SystemClock.nanos;
        view.renderer.onDrawFrame(null);
        Check.that(SystemClock.nanos - before >= 10000000, "a frame that comes too early waits");
        int frames = drawUntilRest();
        Check.that(frames > 60 && frames < 480, frames + " frames of waves");
        Check.that(difference(still, GlContext.pixels(width, height)) <= 8, "water at rest looks as before");
        drawFrame();
        Check.equal(1, GLES20.clears, "frames without water");
    }

    private void aRotationShowsTheOtherPicture() {
        start();
        drawUntilRest();
        surface(LONG, SHORT);
        Check.equal(1, drawUntilRest(), "frames after a rotation");
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

    private void inkShowsAndFadesAndSurvivesAPause() {
        start();
        view.setInk(true);
        drawUntilRest();
        drawStroke();
        Check.that(inked() > 100, "ink along a stroke");

        view.onPause();
        runQueue();
        Check.equal(0, new JniTidemarkRender().getClearInkValue(), "a pause ends the touch");
        surface(SHORT, LONG);
        view.onResume();
        touch(MotionEvent.ACTION_MOVE, 60, 100);
        Check.that(drawUntilRest() < 600, "ink that never rests");
        expectColor(RED);

        drawStroke();
        Check.that(inked() > 100, "ink after a pause");
        view.clearInk();
        drawFrame();
        Check.equal(0, inked(), "ink after it was cleared");
        view.setInk(false);
        drawStroke();
        Check.equal(0, inked(), "ink when it is off");
    }

    private void onlyWhatIsNewIsHandedOver() {
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
        Check.equal(expected, Bitmap.locksMade - before, "hand-overs after " + after);
    }

    private void aPictureOfTwoBytesAPixelIsConverted() {
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
            Check.that(Math.abs((pixels[i] & 255) - expected[i % 4]) <= 8, (pixels[i] & 255) + " at byte " + i);
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
