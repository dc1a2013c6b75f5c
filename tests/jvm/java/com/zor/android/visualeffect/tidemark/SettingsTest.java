package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import android.content.res.TypedArray;
import android.os.Parcelable;
import android.provider.Settings;
import android.view.MotionEvent;

import org.junit.Test;

import java.util.List;

/** The look, the weather and the motion of a view, from calls, from a layout and from a saved state. */
public final class SettingsTest extends ViewFixture {
    @Test
    public void onlyTouchesMoveTheWaterInReducedMotion() {
        Settings.Global.animations = 0;
        view.setFirstDrop(true);
        view.setRain(20);
        start();
        assertTrue("frames without rain and first drop", drawUntilCalm() <= 2);
        view.setMotion(Motion.FULL);
        for (int i = 0; i < 600; ++i) drawFrame();
        assertTrue("it rains", Screen.refreshUntilFrame());
        Settings.Global.animations = 1;
        view.setRain(false);
        assertTrue(drawUntilCalm() > 60);
        detach();
        countedFrames = Screen.frames;
        TestView other = new TestView();
        other.setFirstDrop(true);
        other.setPicture(RED);
        show(other, SHORT, LONG);
        assertTrue("the first drop", drawUntilCalm() > 60);
        other.onDetachedFromWindow();
    }

    @Test
    public void aLookCanChangeAtAnyTime() {
        start();
        drawUntilCalm();
        Look look = plainLook();
        look.meshVertices = 64;
        look.stepsToRest = 5;
        view.setLook(look);
        assertEquals("frames of another mesh", 1, drawUntilCalm());
        view.setLook(look);
        assertEquals("frames of an equal look", 0, drawUntilCalm());
        assertEquals(look, view.getLook());
        look.dropRadius = Float.NaN;  // the view has a copy
        String message = assertThrows(IllegalArgumentException.class, () -> view.setLook(look)).getMessage();
        assertTrue(message, message.contains("dropRadius"));
        assertEquals("frames of an invalid look", 0, drawUntilCalm());
        view.setInkColor(0x99080d);
        view.setRain(12);
        assertEquals(List.of(0xff99080d, 12f, 12f),
                List.of(view.getInkColor(), view.getRain(), view.getLook().rainDropsPerSecond));
        expectColor(RED);
    }

    @Test
    public void aLookChangesTheColoursOfBrightAndDarkPictures() {
        start();
        view.setPicture(0xffffffff);
        drawUntilCalm();
        Look look = plainLook();
        look.wet = 0.6f;
        view.setLook(look);
        drawUntilCalm();
        expectColor(0xffa0acb9);  // 1 - 0.6 times the largest share that water absorbs
        look.groundRed = 0.5f;
        view.setLook(look);
        view.setPicture(GREEN & 0xff3f3f3f);
        drawUntilCalm();
        expectColor(0xff002010);
        view.setPicture(RED);
        drawUntilCalm();
        expectColor(0xff5c3e2e);  // a picture of this brightness absorbs a tenth of that
    }

    @Test
    public void aBreezeFollowsATouchOrBlowsAlwaysButNotInReducedMotion() {
        start();
        drawUntilCalm();
        view.setLook(new Look());
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        int frames = drawUntilCalm();
        assertTrue(frames + " frames of a breeze after a touch", frames > 480 && frames < 1200);
        view.setBreezeAlways(true);
        for (int i = 0; i < 1200; ++i) assertTrue("frames of a breeze", Screen.refreshUntilFrame());
        view.setMotion(Motion.REDUCED);
        countedFrames = Screen.frames;
        assertTrue("the breeze ends", drawUntilCalm() < 480);
        view.setLook(plainLook());
        Look breezy = new Look();
        view.setLook(breezy);
        touch(MotionEvent.ACTION_DOWN, 20, 40);
        assertTrue("ripples without a breeze", drawUntilCalm() < 480);
        assertEquals("the look that was set", breezy, view.getLook());
    }

    @Test
    public void aLayoutAndASavedStateHaveSettings() {
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
        drawUntilCalm();
        expectColor(GREEN);
        assertEquals("the look of a preset", Preset.RED_INK.look(), view.getLook());
        assertTrue("the ink of a preset", view.getInk());
        view.setRain(5);
        Parcelable state = view.onSaveInstanceState();
        detach();
        TestView next = new TestView();
        next.onRestoreInstanceState(state);
        assertEquals(List.of(true, 5f), List.of(next.getInk(), next.getRain()));
        next.setRain(false);
        show(next, SHORT, LONG);
        assertTrue("the restored view draws its picture", drawUntilCalm() > 0);
        expectColor(GREEN);
        next.onDetachedFromWindow();
    }
}
