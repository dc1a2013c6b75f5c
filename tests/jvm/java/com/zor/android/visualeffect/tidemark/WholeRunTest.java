package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertArrayEquals;
import static org.junit.Assert.assertEquals;
import static java.util.Map.entry;

import android.graphics.Bitmap;

import org.junit.Test;

import java.io.ByteArrayInputStream;
import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.HashMap;
import java.util.List;
import java.util.Map;

/** Makes the calls that the host in C++ got: the same comes of each, byte for byte. */
public final class WholeRunTest {
    private interface Call {
        void make(String[] words, double[] n) throws IOException;
    }

    private final Path reference = Path.of(System.getProperty("reference"));
    private final LiveWater water = new LiveWater(new JniTidemarkRender(), new Look(), 1);
    private final Map<String, Bitmap> pictures = new HashMap<>();
    private final StringBuilder journal = new StringBuilder();
    private int width;
    private int height;
    private final Map<String, Call> calls = Map.ofEntries(
            entry("picture", (words, n) -> pictures.put(words[1], read(words[1], (int) n[2], (int) n[3]))),
            entry("pictures", (words, n) -> water.setPictures(
                    new Pictures(pictures.get(words[1]), pictures.get(words[2]), pictures.get(words[3])))),
            entry("context", (words, n) -> {
                GlContext.open(160, 160);
                water.renewContext();
            }),
            entry("resize", (words, n) -> water.resize(width = (int) n[1], height = (int) n[2])),
            entry("ink", (words, n) -> water.setInk(words[1].equals("on"))),
            entry("rain", (words, n) -> water.setRain(words[1].equals("on"))),
            entry("look", (words, n) -> {
                words[0] = "";
                water.setLook(Look.load(new ByteArrayInputStream(String.join("\n", words).getBytes())));
            }),
            entry("clear", (words, n) -> water.clearInk()),
            entry("redraw", (words, n) -> water.redraw()),
            entry("splash", (words, n) -> water.splash((int) n[1], (int) n[2], (float) n[3])),
            entry("touch", (words, n) -> water.touch((int) n[1], (int) n[2], (int) n[3], (float) n[4])),
            entry("frame", (words, n) -> journal.append(water.frame(n[1]).ordinal())),
            entry("keep", (words, n) -> {
                System.gc();  // moves the young arrays
                assertArrayEquals(words[1], Files.readAllBytes(reference.resolve(words[1] + ".rgba")),
                        GlContext.pixels(width, height));
            }));

    @Test
    public void theHostInJavaDrawsWhatTheHostInCppDraws() throws IOException {
        List<String> expected = Files.readAllLines(reference.resolve("journal"));
        for (String line : expected) {
            String[] words = line.split(" ");
            if (!calls.containsKey(words[0])) continue;  // logged by the library
            journal.append(words[0].equals("frame") ? line.substring(0, line.length() - 1) : line);
            double[] n = Arrays.stream(words)
                    .mapToDouble(word -> word.matches("[\\d.]+|0x.*") ? Double.parseDouble(word) : 0).toArray();
            calls.get(words[0]).make(words, n);
            journal.append("\n" + GlContext.takeLog());
        }
        assertEquals(String.join("\n", expected) + "\n", journal.toString());
        assertEquals("bitmaps left locked", 0, Bitmap.locks);
        GlContext.release();
    }

    private Bitmap read(String name, int columns, int rows) throws IOException {
        ByteBuffer rgba = ByteBuffer.wrap(Files.readAllBytes(reference.resolve(name + ".rgba")));
        int[] colors = new int[columns * rows];
        for (int i = 0; i < colors.length; ++i) colors[i] = Integer.rotateRight(rgba.getInt(), 8);
        return Bitmap.createBitmap(colors, columns, rows, Bitmap.Config.ARGB_8888);
    }
}
