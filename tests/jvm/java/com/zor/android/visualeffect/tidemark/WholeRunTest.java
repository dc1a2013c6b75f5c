package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertArrayEquals;
import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertTrue;
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
import java.util.HashSet;
import java.util.Map;
import java.util.Set;

/** Plays a scene to the host in Java: frames, log and pictures are those of the host in C++, byte for byte. */
public final class WholeRunTest {
    private final Path reference = Path.of(System.getProperty("reference"));
    private final LiveWater water = new LiveWater(new JniTidemarkRender(), new Look(), 1);
    private final Map<String, Bitmap> pictures = new HashMap<>();
    private final Set<ByteBuffer> seen = new HashSet<>();
    private int width;
    private int height;
    private int drawn;
    private int waited;
    private double now;

    private interface Command {
        void run(String[] words, double[] n) throws IOException;
    }

    private final Map<String, Command> commands = Map.ofEntries(
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
                StringBuilder lines = new StringBuilder();
                for (int i = 1; i < words.length; i += 2) lines.append(words[i] + " = " + words[i + 1] + "\n");
                water.setLook(Look.load(new ByteArrayInputStream(lines.toString().getBytes())));
            }),
            entry("clear", (words, n) -> water.clearInk()),
            entry("redraw", (words, n) -> water.redraw()),
            entry("touch", (words, n) -> water.touch((int) n[1], (int) n[2], (int) n[3], (float) n[4])),
            entry("stroke", (words, n) -> {
                water.touch(WaterHost.DOWN, (int) n[1], (int) n[2], (float) n[6]);
                for (int i = 1; i <= n[5]; ++i, frame(60)) {
                    water.touch(WaterHost.MOVE, (int) n[1] + (int) (n[3] - n[1]) * i / (int) n[5],
                            (int) n[2] + (int) (n[4] - n[2]) * i / (int) n[5], (float) n[6]);
                }
            }),
            entry("frames", (words, n) -> {
                for (int i = 0; i < n[1]; ++i) frame(n[2]);
            }),
            entry("rest", (words, n) -> {
                while (frame(60) != LiveWater.Frame.RESTING && drawn < 2000) continue;
            }),
            entry("wait", (words, n) -> now += n[1]),
            entry("keep", (words, n) -> {
                byte[] pixels = GlContext.pixels(width, height);
                assertArrayEquals(words[1], Files.readAllBytes(reference.resolve(words[1] + ".rgba")), pixels);
                assertTrue(words[1] + " shows nothing new", seen.add(ByteBuffer.wrap(pixels)));
            }));

    @Test
    public void theHostInJavaDrawsWhatTheHostInCppDraws() throws IOException {
        StringBuilder journal = new StringBuilder();
        int drawnInAll = 0;
        for (String line : Files.readAllLines(Path.of(System.getProperty("scene")))) {
            if (line.isEmpty() || line.startsWith("#")) continue;
            drawn = waited = 0;
            String[] words = line.split(" ");
            double[] n = Arrays.stream(words)
                    .mapToDouble(word -> word.matches("[\\d.]+") ? Double.parseDouble(word) : 0).toArray();
            commands.get(words[0]).run(words, n);
            System.gc();  // moves the young arrays
            drawnInAll += drawn;
            journal.append(line + ": " + drawn + " drawn, " + waited + " waited\n" + GlContext.takeLog());
        }
        assertEquals(Files.readString(reference.resolve("journal")), journal.toString());
        assertTrue("only " + drawnInAll + " frames", drawnInAll >= 1000);
        assertEquals("bitmaps left locked", 0, Bitmap.locks);
        GlContext.release();
    }

    private LiveWater.Frame frame(double rate) {
        LiveWater.Frame frame = water.frame(now += 1 / rate);
        if (frame == LiveWater.Frame.DRAWN) ++drawn;
        if (frame == LiveWater.Frame.WAITING) ++waited;
        return frame;
    }

    private Bitmap read(String name, int columns, int rows) throws IOException {
        ByteBuffer rgba = ByteBuffer.wrap(Files.readAllBytes(reference.resolve(name + ".rgba")));
        int[] colors = new int[columns * rows];
        for (int i = 0; i < colors.length; ++i) colors[i] = Integer.rotateRight(rgba.getInt(), 8);
        return Bitmap.createBitmap(colors, columns, rows, Bitmap.Config.ARGB_8888);
    }
}
