package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertNull;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import android.content.ComponentCallbacks2;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.os.Parcelable;
import android.os.SystemClock;
import android.provider.Settings;
import android.view.MotionEvent;
import android.graphics.SurfaceTexture;
import android.view.Surface;
import android.view.SurfaceView;

import org.junit.After;
import org.junit.Test;

import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;

/** The view, from the call and the touch to the screen: when it draws, when it rests, what it shows and what it tells. */
public final class ViewTest {
    private static final int LONG = 160;
    private static final int SHORT = 90;
    private static final int RED = 0xffc04030;
    private static final int GREEN = 0xff40a050;

    private final List<String> heard = new ArrayList<>();
    private final TestView view = new TestView();
    private final Bitmap red = plain(Bitmap.Config.ARGB_8888, RED);
    private final Bitmap green = plain(Bitmap.Config.ARGB_8888, GREEN);
    private int framesSeen = Screen.frames;
    private int handedOver = Bitmap.locksMade;

    @After
    public void release() {
        view.onDetachedFromWindow();
        Screen.settle();
    }

    @Test
    public void drawsWhileSomethingMoves() {
        view.setListener(new Heard());
        show(view, SHORT, LONG);
        assertEquals("frames without a picture", 0, drawUntilRest());
        view.setPicture(RED);
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
        expectColor(RED);
        hide(view);
        view.drop(40, 40);
        show(view, SHORT, LONG);
        assertTrue("a drop of a pause is forgotten", drawUntilRest() < 3);
        assertEquals(List.of("ready", "calm", "wake", "calm"), heard);
    }

    @Test
    public void inkShowsAndFadesAndSurvivesAPause() {
        start();
        view.setInk(true);
        drawUntilRest();
        long before = SystemClock.nanos;
        Screen.refreshRate = 240;
        drawStroke();
        Screen.refreshRate = 60;
        assertTrue("ink along a stroke", inked() > 100);
        assertTrue("20 frames take the time of 20 steps of the ink", SystemClock.nanos - before > 250000000);
        hide(view);
        assertEquals("frames of a view that is not seen", 0, drawUntilRest());
        show(view, SHORT, LONG);
        drawFrame();
        assertTrue("ink goes on after a pause", inked() > 100);
        assertTrue("ink that never rests", drawUntilRest() < 600);
        expectColor(RED);

        drawStroke();
        view.clearInk();
        drawFrame();
        assertEquals("ink after it was cleared", 0, inked());
        drawStroke();
        view.setInk(false);
        drawFrame();
        view.setInk(true);
        drawFrame();
        assertEquals("a switch clears the ink", 0, inked());
    }

    @Test
    public void onlyWhatIsNewIsHandedOver() {
        show(view, LONG, LONG);
        expectHandOvers(0, "before there are pictures");
        view.setPictures(red, green, null);
        expectHandOvers(3, "the first pictures");
        view.setPictures(red, green, null);
        view.setInk(true);
        expectHandOvers(0, "ink");
        show(view, LONG, SHORT);
        expectHandOvers(2, "a view of other proportions");
        show(view, SHORT, LONG);
        Screen.isLost = true;
        expectHandOvers(0, "a view turned, and a lost context");
        view.setPictures(red, red, null);
        expectHandOvers(2, "another picture, and the light decoded again");
    }

    private void expectHandOvers(int expected, String after) {
        drawUntilRest();
        assertEquals("hand-overs after " + after, expected, Bitmap.locksMade - handedOver);
        handedOver = Bitmap.locksMade;
    }

    @Test
    public void anyPictureWillDo() {
        show(view, SHORT, LONG);
        for (Bitmap.Config config : Bitmap.Config.values()) {
            int color = 0xff102030 + 0x400000 * config.ordinal();
            view.setPicture(plain(config, color));
            drawUntilRest();
            expectColor(color);
        }
        int[] colors = new int[500 * 640];
        for (int i = 0; i < colors.length; ++i) {  // a chessboard between red margins
            int x = i % 500;
            colors[i] = x < 70 || x >= 430 ? RED : (x / 2 + i / 1000) % 2 == 0 ? 0xff000000 : 0xffffffff;
        }
        Bitmap board = Bitmap.createBitmap(colors, 500, 640, Bitmap.Config.ARGB_8888);
        Bitmap fitted = new Pictures(board, board, board).fitted(0, SHORT, LONG);
        assertEquals(SHORT + " x " + LONG, fitted.getWidth() + " x " + fitted.getHeight());
        for (int i = 0; i < fitted.pixels.capacity(); i += 4) assertEquals(127, fitted.pixels.get(i) & 255, 1);
        Bitmap panorama = Bitmap.createBitmap(5000, 20, Bitmap.Config.ARGB_8888);
        assertEquals("of a light", 1024, new Pictures(red, red, panorama).fitted(2, 0, 0).getWidth());
        assertEquals("a panorama keeps the pixels of its height", 1, PictureLoader.samples(6000, 1500, 1000));
        assertEquals(4, PictureLoader.samples(8000, 6000, 1000));
    }

    @Test
    public void whatCannotBeUsedLeavesThePictureThatIsThere() {
        start();
        drawUntilRest();
        view.setPicture(green);
        view.setPicture(TestActivity.NO_PICTURE);
        drawUntilRest();
        expectColor(RED);
        view.setListener(new Heard());
        assertEquals("a listener that comes late", List.of("PICTURE", "ready", "calm"), heard);
        view.setPicture(green);
        drawUntilRest();
        green.recycle();
        show(view, LONG, LONG);
        drawUntilRest();
        expectColor(GREEN);
        assertEquals(List.of("PICTURE", "PICTURE"), heard.subList(3, 5));
        assertThrows(IllegalArgumentException.class, () -> view.setPicture(green));
        assertThrows(IllegalArgumentException.class, () -> view.setPictures(0, 0, 0));
    }

    @Test
    public void theNewestViewWithAPictureDraws() {
        start();
        view.setInk(true);
        view.setListener(new Heard());
        drawUntilRest();
        TestView newer = new TestView();
        show(newer, SHORT, LONG);
        view.drop(40, 40);
        assertTrue("the older view draws on", drawUntilRest() > 60);
        newer.setPictures(green, green, null);
        drawUntilRest();
        expectColor(GREEN);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("frames of an older view", 0, drawUntilRest());
        assertNull(view.toBitmap());
        newer.setInk(true);
        drawStroke(newer);
        show(view, SHORT, LONG);
        for (int i = 1; i <= 20; ++i) {
            touch(MotionEvent.ACTION_MOVE, 50 + i, 80 + 2 * i);
            drawFrame();
        }
        assertEquals("ink of the other view's stroke", 0, inked());
        drawUntilRest();
        expectColor(RED);
        assertEquals(List.of("ready", "calm", "wake", "calm", "rest", "calm"), heard.subList(0, 6));
        newer.setInk(false);
        hide(view);
        drawUntilRest();
        assertEquals("the red of the other view, which goes on by itself", 0x40, Screen.pixels[0] & 255, 8);

        int[] objects = new int[8];
        for (int turn = 0; turn < 8; ++turn) {
            show(turn % 2 == 0 ? view : newer, SHORT, LONG);
            drawUntilRest();
            int at = turn;
            GlThread.await(() -> objects[at] = GlContext.countObjects());
        }
        assertEquals("objects on the GPU after more turns", objects[1], objects[7]);
        hide(newer);
        drawUntilRest();
        expectColor(RED);
        newer.onDetachedFromWindow();
    }

    @Test
    public void memoryIsGivenBackWhileNothingDraws() {
        start();
        drawUntilRest();
        Screen.process.onTrimMemory(ComponentCallbacks2.TRIM_MEMORY_BACKGROUND);
        expectHandOvers(3, "a trim while a view draws");
        hide(view);
        Screen.process.onTrimMemory(ComponentCallbacks2.TRIM_MEMORY_BACKGROUND - 20);
        expectHandOvers(0, "a trim that is none");
        Screen.process.onTrimMemory(ComponentCallbacks2.TRIM_MEMORY_BACKGROUND);
        expectHandOvers(3, "a trim, of single pixels");
        show(view, SHORT, LONG);
        expectHandOvers(3, "the way back");
        expectColor(RED);
    }

    @Test
    public void theSurfaceHasTheSizeOfTheQuality() {
        start();
        drawUntilRest();
        view.setQuality(Quality.LOW);
        view.onSizeChanged(LONG, LONG, 0, 0);
        drawUntilRest();
        assertEquals("80 x 80", SurfaceView.sizeSet);
        Screen.width = Screen.height = 80;
        view.drawOn(view.surface, 80, 80);
        view.onSizeChanged(LONG, LONG, 0, 0);
        drawUntilRest();
        expectColor(RED);
        byte[] still = Screen.pixels;
        touch(MotionEvent.ACTION_DOWN, LONG / 2, LONG / 4);
        for (int i = 0; i < 8; ++i) drawFrame();
        assertTrue("a touch is where it is in the view", difference(rowOf(still), rowOf(Screen.pixels)) > 30);
    }

    @Test
    public void aTextureIsDrawnOnWhileItIsSeen() {
        SurfaceTexture texture = new SurfaceTexture(0);
        WaterSurface surface = new WaterSurface(new TestActivity(), true,
                (window, width, height) -> heard.add(window == texture ? width + " x " + height : "none"));
        surface.setSeen(true);
        surface.onSurfaceTextureAvailable(texture, SHORT, LONG);
        surface.setSize(60, 80);
        surface.onSurfaceTextureSizeChanged(texture, LONG, LONG);
        surface.setSeen(false);
        surface.setSeen(true);
        surface.onSurfaceTextureDestroyed(texture);
        surface.setSize(30, 40);
        assertEquals(List.of("90 x 160", "60 x 80", "none", "60 x 80", "none"), heard);
    }

    @Test
    public void codeMovesTheWaterAsAFingerDoes() {
        show(view, LONG, LONG);
        view.setInk(true);
        view.setPictures(red, green, null);
        view.drop(LONG / 2, LONG / 2, 1, true);
        for (int i = 0; i < 20; ++i) drawFrame();
        assertTrue("ink of a drop before the first frame", inked() > 20);
        view.clearInk();
        show(view, SHORT, LONG);
        drawUntilRest();
        view.stroke(new float[] {30, 40, 50, 80, 60, 120}, 400);
        for (int i = 0; i < 40; ++i) drawFrame();
        assertTrue("ink of a stroke", inked() > 100);
        Bitmap picture = view.toBitmap();  // of one more frame
        int shown = Screen.pixels[4 * SHORT * 20] & 255;
        assertEquals("a picture, upright", shown, picture.pixels.get(4 * SHORT * (LONG - 21)) & 255);

        drawFrame();
        view.pause();
        drawUntilRest();
        assertEquals("frames of a pause", 0, drawUntilRest());
        view.play();
        drawFrame();
        assertTrue("it goes on", drawUntilRest() > 60);
        assertThrows(IllegalArgumentException.class, () -> view.stroke(new float[] {1}, 400));
    }

    @Test
    public void reducedMotionLeavesTheWaterToTouches() {
        Settings.Global.animations = 0;
        view.setFirstDrop(true);
        view.setRain(20);
        start();
        assertTrue("frames without rain and first drop", drawUntilRest() <= 2);
        view.setMotion(Motion.FULL);
        for (int i = 0; i < 600; ++i) drawFrame();
        assertTrue("it rains", Screen.goOn());
        Settings.Global.animations = 1;
        view.setRain(false);
        assertTrue(drawUntilRest() > 60);
        release();
        framesSeen = Screen.frames;
        TestView other = new TestView();
        other.setFirstDrop(true);
        other.setPicture(RED);
        show(other, SHORT, LONG);
        assertTrue("the first drop", drawUntilRest() > 60);
        other.onDetachedFromWindow();
    }

    @Test
    public void touchesAreTakenWhereThereIsWater() {
        show(view, SHORT, LONG);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        view.setPicture(RED);
        drawUntilRest();
        assertEquals("without a picture", 0, view.claims);
        view.setInteraction(Interaction.PRESS_OR_SCROLL);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        touch(MotionEvent.ACTION_CANCEL, 20, 40);
        assertEquals("where a list may scroll", 0, view.claims);
        assertTrue("it ripples all the same", drawUntilRest() > 60);
        view.setInteraction(Interaction.NONE);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        view.setInteraction(Interaction.PRESS);
        view.isEnabled = false;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("frames of touches that are not taken", 0, drawUntilRest());
        view.isEnabled = true;
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertEquals("of a finger that draws", 1, view.claims);
    }

    @Test
    public void aLookIsTakenAtAnyTime() {
        start();
        drawUntilRest();
        Look look = plainLook();
        look.meshVertices = 64;
        look.stepsToRest = 5;
        view.setLook(look);
        assertEquals("frames of another mesh", 1, drawUntilRest());
        view.setLook(look);
        assertEquals("frames of an equal look", 0, drawUntilRest());
        assertEquals(look, view.getLook());
        look.dropRadius = Float.NaN;  // the view has its own copy
        String message = assertThrows(IllegalArgumentException.class, () -> view.setLook(look)).getMessage();
        assertTrue(message, message.contains("dropRadius"));
        assertEquals("frames of a look that is refused", 0, drawUntilRest());
        view.setInkColor(0x99080d);
        view.setRain(12);
        assertEquals(List.of(0xff99080d, 12f, 12f),
                List.of(view.getInkColor(), view.getRain(), view.getLook().rainDropsPerSecond));
        expectColor(RED);
    }

    @Test
    public void aLookColoursBrightPicturesAndDarkOnes() {
        start();
        view.setPicture(0xffffffff);
        drawUntilRest();
        Look look = plainLook();
        look.wet = 0.6f;
        view.setLook(look);
        drawUntilRest();
        expectColor(0xffa0acb9);  // 1 - 0.6 times what water takes at most
        look.groundRed = 0.5f;
        view.setLook(look);
        view.setPicture(GREEN & 0xff3f3f3f);
        drawUntilRest();
        expectColor(0xff002010);
        view.setPicture(RED);
        drawUntilRest();
        expectColor(0xff5c3e2e);  // of this brightness, a tenth of it
    }

    @Test
    public void aBreezeFollowsATouchOrBlowsAlwaysButNotInReducedMotion() {
        start();
        drawUntilRest();
        view.setLook(new Look());
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        int frames = drawUntilRest();
        assertTrue(frames + " frames of a breeze after a touch", frames > 480 && frames < 1200);
        view.setBreezeAlways(true);
        for (int i = 0; i < 1200; ++i) assertTrue("frames of a breeze", Screen.goOn());
        view.setMotion(Motion.REDUCED);
        framesSeen = Screen.frames;
        assertTrue("the breeze ends", drawUntilRest() < 480);
        view.setLook(plainLook());
        Look breezy = new Look();
        view.setLook(breezy);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertTrue("ripples alone", drawUntilRest() < 480);
        assertEquals("what is set stays", breezy, view.getLook());
    }

    @Test
    public void aLayoutAndASavedStateSayWhatTheViewShows() {
        ViewAttributes.apply(new TypedArray() {
            @Override
            public boolean getBoolean(int index, boolean usual) {
                return usual;
            }

            @Override
            public float getFloat(int index, float usual) {
                return usual;
            }

            @Override
            public int getInt(int index, int usual) {
                return index == R.styleable.TidemarkView_tidemarkPreset ? Preset.RED_INK.ordinal() : usual;
            }

            @Override
            public int getResourceId(int index, int usual) {
                return index == R.styleable.TidemarkView_tidemarkPicture ? GREEN : usual;
            }
        }, view);
        show(view, SHORT, LONG);
        drawUntilRest();
        expectColor(GREEN);
        assertEquals("of a preset", Preset.RED_INK.look(), view.getLook());
        assertTrue("ink of a preset", view.getInk());
        view.setRain(5);
        Parcelable state = view.onSaveInstanceState();
        release();
        TestView next = new TestView();
        next.onRestoreInstanceState(state);
        assertEquals(List.of(true, 5f), List.of(next.getInk(), next.getRain()));
        next.setRain(false);
        show(next, SHORT, LONG);
        drawUntilRest();
        expectColor(GREEN);
        next.onDetachedFromWindow();
    }

    private final class Heard implements TidemarkListener {
        @Override
        public void onReady() {
            heard.add("ready");
        }

        @Override
        public void onCalm() {
            heard.add("calm");
        }

        @Override
        public void onWake() {
            heard.add("wake");
        }

        @Override
        public void onRest() {
            heard.add("rest");
        }

        @Override
        public void onFailure(Failure failure, String message) {
            heard.add(failure.name());
        }
    }

    private static final class TestView extends TidemarkView {
        final Surface surface = new Surface((SurfaceTexture) null);
        int claims;  // of a finger that no list may take
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

    private void start() {
        view.setPictures(red, green, null);
        show(view, SHORT, LONG);
    }

    private static void show(TestView view, int width, int height) {
        Screen.width = width;
        Screen.height = height;
        view.drawOn(view.surface, width, height);
        Screen.settle();
    }

    private static void hide(TidemarkView view) {
        view.drawOn(null, 0, 0);
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
    }

    private void drawStroke(TidemarkView view) {
        touch(view, MotionEvent.ACTION_DOWN, 30, 40);
        for (int i = 1; i <= 20; ++i) {
            touch(view, MotionEvent.ACTION_MOVE, 30 + i, 40 + 2 * i);
            drawFrame();
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
        Screen.goOn();
        framesSeen = Screen.frames;
    }

    private int drawUntilRest() {
        for (int i = 0; Screen.goOn() && i < 3000; ++i) continue;
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

    // Rests as soon as the waves are gone, and leaves pictures their colours.
    private static Look plainLook() {
        Look look = new Look();
        look.breeze = 0;
        look.wet = 0;
        return look;
    }

    private static Bitmap plain(Bitmap.Config config, int argb) {
        int[] colors = new int[40 * 40];
        Arrays.fill(colors, argb);
        return Bitmap.createBitmap(colors, 40, 40, config);
    }
}
