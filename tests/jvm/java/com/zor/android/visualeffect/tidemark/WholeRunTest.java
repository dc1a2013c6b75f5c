package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertArrayEquals;
import static org.junit.Assert.assertEquals;

import android.graphics.Bitmap;

import com.example.water.MinimalWater;

import org.junit.Test;

import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.file.Files;
import java.nio.file.Path;

/** Pictures and log lines of the smallest host are equal to those of the same calls in C++, byte for byte. */
public final class WholeRunTest {
    private final Path reference = Path.of(System.getProperty("reference"));
    private MinimalWater water;
    private int width;
    private int height;

    @Test
    public void picturesAndLogAreThoseOfCpp() throws IOException {
        GlContext.takeLog();
        water = new MinimalWater(picture("portrait", 90, 160), picture("landscape", 160, 90), picture("light", 64, 64));
        surface(90, 160);
        water.onDrawFrame(null);  // before the first step is due
        expectFrame("still");
        water.touch(30, 40, 0, 1);
        for (int i = 1; i <= 30; ++i) {
            water.touch(30 + i, 40 + 2 * i, 2, 1);
            frame();
        }
        expectFrame("stroke");
        assertEquals("ink in a stroke", true, water.showsInk());
        water.touch(60, 100, 1, 0.5f);
        for (int i = 0; i < 10; ++i) frame();
        expectFrame("lifted");
        water.clearInk();
        frame();
        expectFrame("cleared");
        assertEquals("ink after it was cleared", false, water.showsInk());
        surface(160, 90);
        water.touch(45, 45, 0, 1);
        for (int i = 0; i < 10; ++i) frame();
        expectFrame("turned");
        assertEquals(Files.readString(reference.resolve("log")), GlContext.takeLog());
        assertEquals("bitmaps left locked", 0, Bitmap.locks);
        GlContext.release();
    }

    private void surface(int width, int height) {
        this.width = width;
        this.height = height;
        GlContext.open(160, 160);
        water.onSurfaceCreated(null, null);
        water.onSurfaceChanged(null, width, height);
    }

    private void frame() {
        water.step();
        water.draw();
    }

    private void expectFrame(String name) throws IOException {
        System.gc();  // moves arrays in memory
        assertArrayEquals(name, Files.readAllBytes(reference.resolve(name)), GlContext.pixels(width, height));
    }

    private Bitmap picture(String name, int columns, int rows) throws IOException {
        ByteBuffer rgba = ByteBuffer.wrap(Files.readAllBytes(reference.resolve(name)));
        int[] colors = new int[columns * rows];
        for (int i = 0; i < colors.length; ++i) colors[i] = Integer.rotateRight(rgba.getInt(), 8);
        return Bitmap.createBitmap(colors, columns, rows, Bitmap.Config.ARGB_8888);
    }
}
