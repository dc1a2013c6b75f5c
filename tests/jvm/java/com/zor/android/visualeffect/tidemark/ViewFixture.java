package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertTrue;

import android.graphics.Bitmap;
import android.graphics.SurfaceTexture;
import android.view.MotionEvent;
import android.view.Surface;

import org.junit.After;

import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;

/** A view that draws on the test's screen, and the calls of its listener. */
abstract class ViewFixture {
    static final int LONG = 160;
    static final int SHORT = 90;
    static final int RED = 0xffc04030;
    static final int GREEN = 0xff40a050;

    final List<String> calls = new ArrayList<>();
    final TestView view = new TestView();
    final Bitmap red = plain(Bitmap.Config.ARGB_8888, RED);
    final Bitmap green = plain(Bitmap.Config.ARGB_8888, GREEN);
    int countedFrames = Screen.frames;
    private int countedLocks = Bitmap.locksMade;

    static final class TestView extends TidemarkView {
        final Surface surface = new Surface((SurfaceTexture) null);
        int claims;  // how often parents were kept from intercepting a finger
        boolean isEnabled = true;

        TestView() {
            super(new TestActivity());
            setLook(plainLook());
        }

        @Override
        public boolean isEnabled() {
            return isEnabled;
        }

        @Override
        void claimFinger() {
            ++claims;
        }
    }

    final class RecordingListener implements TidemarkListener {
        @Override
        public void onReady() {
            calls.add("ready");
        }

        @Override
        public void onCalm() {
            calls.add("calm");
        }

        @Override
        public void onWake() {
            calls.add("wake");
        }

        @Override
        public void onRest() {
            calls.add("rest");
        }

        @Override
        public void onFailure(Failure failure, String message) {
            calls.add(failure.name());
        }
    }

    @After
    public void detach() {
        view.onDetachedFromWindow();
        Screen.settle();
    }

    void start() {
        view.setPictures(red, green, null);
        show(view, SHORT, LONG);
    }

    static void show(TestView view, int width, int height) {
        Screen.width = width;
        Screen.height = height;
        view.drawOn(view.surface, width, height);
        Screen.settle();
    }

    static void hide(TidemarkView view) {
        view.drawOn(null, 0, 0);
    }

    void touch(int action, float x, float y) {
        touch(view, action, x, y);
    }

    private static void touch(TidemarkView view, int action, float x, float y) {
        view.onTouchEvent(new MotionEvent(action, 0, new int[] {0}, new float[][][] {{{x, y, 1}}}));
    }

    /** Draws a slow stroke in 20 frames. The finger stays down. */
    void drawStroke(TidemarkView view) {
        touch(view, MotionEvent.ACTION_DOWN, 30, 40);
        for (int i = 1; i <= 20; ++i) {
            touch(view, MotionEvent.ACTION_MOVE, 30 + i, 40 + 2 * i);
            drawFrame();
        }
    }

    void drawFrame() {
        Screen.refreshUntilFrame();
        countedFrames = Screen.frames;
    }

    /** Returns the number of frames since the last one that was counted. */
    int drawUntilCalm() {
        for (int i = 0; Screen.refreshUntilFrame() && i < 3000; ++i) continue;
        int frames = Screen.frames - countedFrames;
        countedFrames += frames;
        return frames;
    }

    /** Counts the pixels that are darker than the background. */
    int inkedPixels() {
        byte[] pixels = Screen.pixels;
        int dark = 0;
        for (int i = 0; i < pixels.length; i += 4) {
            if ((pixels[i] & 255) < 150) ++dark;
        }
        return dark;
    }

    void expectColor(int argb) {
        int[] expected = {argb >> 16 & 255, argb >> 8 & 255, argb & 255};
        byte[] pixels = Screen.pixels;
        for (int i = 0; i < pixels.length; ++i) {
            if (i % 4 == 3) continue;
            assertTrue((pixels[i] & 255) + " at byte " + i, Math.abs((pixels[i] & 255) - expected[i % 4]) <= 8);
        }
    }

    /** Expects so many pictures to be passed to the library since the last call. */
    void expectTransfers(int expected, String after) {
        drawUntilCalm();
        assertEquals("transfers after " + after, expected, Bitmap.locksMade - countedLocks);
        countedLocks = Bitmap.locksMade;
    }

    /** Returns the largest difference of two bytes. */
    static int difference(byte[] one, byte[] other) {
        int most = 0;
        for (int i = 0; i < one.length; ++i) most = Math.max(most, Math.abs((one[i] & 255) - (other[i] & 255)));
        return most;
    }

    /** Returns a look with which the water is calm as soon as the waves are gone, and pictures keep their colours. */
    static Look plainLook() {
        Look look = new Look();
        look.breeze = 0;
        look.wet = 0;
        return look;
    }

    static Bitmap plain(Bitmap.Config config, int argb) {
        int[] colors = new int[40 * 40];
        Arrays.fill(colors, argb);
        return Bitmap.createBitmap(colors, 40, 40, config);
    }
}
