package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;

import android.graphics.Bitmap;

import org.junit.Test;

import java.util.List;

/** The pictures of a view: their form, their failures, and how often they are passed to the library. */
public final class ViewPicturesTest extends ViewFixture {
    @Test
    public void onlyChangesAreTransferred() {
        show(view, LONG, LONG);
        expectTransfers(0, "the start without pictures");
        view.setPictures(red, green, null);
        expectTransfers(3, "the first pictures");
        view.setPictures(red, green, null);
        view.setInk(true);
        expectTransfers(0, "the same pictures and ink");
        show(view, LONG, SHORT);
        expectTransfers(2, "other proportions of the view");
        show(view, SHORT, LONG);
        Screen.isLost = true;
        expectTransfers(0, "a rotation, and a lost context");
        view.setPictures(red, red, null);
        expectTransfers(2, "another picture, and the light decoded again");
    }

    @Test
    public void picturesOfAnyFormAreShown() {
        show(view, SHORT, LONG);
        for (Bitmap.Config config : Bitmap.Config.values()) {
            int color = 0xff102030 + 0x400000 * config.ordinal();
            view.setPicture(plain(config, color));
            drawUntilCalm();
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
        assertEquals("width of a light", 1024, new Pictures(red, red, panorama).fitted(2, 0, 0).getWidth());
        assertEquals("a panorama keeps the pixels of its height", 1, PictureLoader.samples(6000, 1500, 1000));
        assertEquals(4, PictureLoader.samples(8000, 6000, 1000));
    }

    @Test
    public void exifOrientationsAreApplied() {
        // The sides of the picture at which the file's first row and first column are, for orientations from 1 on.
        String[] sides = {"top left", "top right", "bottom right", "bottom left", "left top", "right top", "right bottom",
                "left bottom"};
        int[] upright = {1, 2, 3, 4, 5, 6};  // two columns, three rows
        for (int orientation = 1; orientation <= sides.length; ++orientation) {
            String around = sides[orientation - 1];
            boolean isTurned = orientation > 4;
            int columns = isTurned ? 3 : 2;
            int[] stored = new int[6];
            for (int i = 0; i < stored.length; ++i) {
                int column = i % columns;
                int row = i / columns;
                int x = isTurned ? row : column;
                int y = isTurned ? column : row;
                if (around.contains("right")) x = 1 - x;
                if (around.contains("bottom")) y = 2 - y;
                stored[i] = upright[2 * y + x];
            }
            Bitmap file = Bitmap.createBitmap(stored, columns, 6 / columns, Bitmap.Config.ARGB_8888);
            Bitmap shown = PictureLoader.upright(file, orientation);
            assertEquals("columns of orientation " + orientation, 2, shown.getWidth());
            for (int i = 0; i < 6; ++i) assertEquals("orientation " + orientation, i + 1, shown.getPixel(i % 2, i / 2));
        }
        assertEquals("an unknown orientation", red, PictureLoader.upright(red, 9));
    }

    @Test
    public void afterAFailureTheLastUsablePictureIsShown() {
        view.setPicture(RED);
        view.setPicture(TestActivity.NO_PICTURE);
        show(view, SHORT, LONG);
        drawUntilCalm();
        expectColor(RED);
        view.setListener(new RecordingListener());
        assertEquals("calls of a late listener", List.of("PICTURE", "ready", "calm"), calls);
        view.setPicture(green);
        drawUntilCalm();
        green.recycle();
        show(view, LONG, LONG);
        drawUntilCalm();
        expectColor(GREEN);
        assertEquals(List.of("PICTURE", "PICTURE"), calls.subList(3, 5));
        assertThrows(IllegalArgumentException.class, () -> view.setPicture(green));
        assertThrows(IllegalArgumentException.class, () -> view.setPictures(0, 0, 0));
    }
}
