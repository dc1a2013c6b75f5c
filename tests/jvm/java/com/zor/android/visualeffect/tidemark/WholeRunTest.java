package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

import java.io.ByteArrayInputStream;
import java.io.IOException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.HashMap;
import java.util.List;
import java.util.Map;

/** Plays a scene to the host in Java: frames, log and pictures are those of the host in C++, byte for byte. */
public final class WholeRunTest {
    private static final int SIDE = 160;  // of the framebuffer

    private final Path reference;
    private final JniTidemarkRender library = new JniTidemarkRender();
    private final LiveWater water = new LiveWater(library, new Look(), 1);
    private final Map<String, Bitmap> pictures = new HashMap<>();
    private final StringBuilder journal = new StringBuilder();
    private final List<byte[]> seen = new ArrayList<>();
    private int width;
    private int height;
    private double now;
    private int drawn;
    private int waited;
    private int drawnInAll;

    public static void main(String[] arguments) throws IOException {
        WholeRunTest test = new WholeRunTest(Path.of(arguments[1]));
        for (String line : Files.readAllLines(Path.of(arguments[0]))) {
            if (!line.isEmpty() && !line.startsWith("#")) test.playLine(line);
        }
        test.checkEnd(Files.readString(Path.of(arguments[2])));
        GlContext.release();
    }

    private WholeRunTest(Path reference) {
        this.reference = reference;
    }

    private void playLine(String line) throws IOException {
        drawn = waited = 0;
        play(line.split(" "));
        journal.append(line + ": " + drawn + " drawn, " + waited + " waited\n" + GlContext.takeLog());
        drawnInAll += drawn;
    }

    private void play(String[] words) throws IOException {
        switch (words[0]) {
            case "picture":
                pictures.put(words[1], read(words[1], Integer.parseInt(words[2]), Integer.parseInt(words[3])));
                break;
            case "pictures":
                water.setPictures(
                        new Pictures(pictures.get(words[1]), pictures.get(words[2]), pictures.get(words[3])));
                break;
            case "context":
                GlContext.open(SIDE, SIDE);
                water.renewContext();
                break;
            case "resize":
                width = Integer.parseInt(words[1]);
                height = Integer.parseInt(words[2]);
                water.resize(width, height);
                break;
            case "ink":
                water.setInk(words[1].equals("on"));
                break;
            case "rain":
                water.setRain(words[1].equals("on"));
                break;
            case "look":
                water.setLook(look(words));
                break;
            case "clear":
                water.clearInk();
                library.getClearInkValue();
                break;
            case "redraw":
                water.redraw();
                break;
            case "touch":
                water.touch(Integer.parseInt(words[1]), Integer.parseInt(words[2]), Integer.parseInt(words[3]),
                        Float.parseFloat(words[4]));
                break;
            case "stroke":
                stroke(Arrays.stream(words, 1, 6).mapToInt(Integer::parseInt).toArray(), Float.parseFloat(words[6]));
                break;
            case "frames":
                for (int i = Integer.parseInt(words[1]); i > 0; --i) frame(Double.parseDouble(words[2]));
                break;
            case "rest":
                while (frame(60) != LiveWater.Frame.RESTING && drawn < 2000) continue;
                break;
            case "wait":
                now += Double.parseDouble(words[1]);
                break;
            case "keep":
                comparePicture(words[1]);
                break;
            default:
                throw new AssertionError("cannot play " + words[0]);
        }
    }

    private Bitmap read(String name, int columns, int rows) throws IOException {
        byte[] rgba = Files.readAllBytes(reference.resolve(name + ".rgba"));
        int[] colors = new int[columns * rows];
        for (int i = 0; i < colors.length; ++i) {
            colors[i] = 0xff000000 | (rgba[4 * i] & 255) << 16 | (rgba[4 * i + 1] & 255) << 8 | rgba[4 * i + 2] & 255;
        }
        return Bitmap.createBitmap(colors, columns, rows, Bitmap.Config.ARGB_8888);
    }

    private static Look look(String[] words) throws IOException {
        StringBuilder lines = new StringBuilder();
        for (int i = 1; i < words.length; i += 2) lines.append(words[i] + " = " + words[i + 1] + "\n");
        return Look.load(new ByteArrayInputStream(lines.toString().getBytes()));
    }

    private void stroke(int[] path, float pressure) {
        water.touch(WaterHost.DOWN, path[0], path[1], pressure);
        for (int i = 1; i <= path[4]; ++i) {
            int x = path[0] + (path[2] - path[0]) * i / path[4];
            int y = path[1] + (path[3] - path[1]) * i / path[4];
            water.touch(WaterHost.MOVE, x, y, pressure);
            frame(60);
        }
    }

    // The collector moves every array between the frames.
    private LiveWater.Frame frame(double rate) {
        LiveWater.Frame frame = water.frame(now += 1 / rate);
        if (frame == LiveWater.Frame.DRAWN) ++drawn;
        if (frame == LiveWater.Frame.WAITING) ++waited;
        System.gc();
        return frame;
    }

    private void comparePicture(String name) throws IOException {
        byte[] expected = Files.readAllBytes(reference.resolve(name + ".rgba"));
        byte[] actual = GlContext.pixels(width, height);
        Check.that(Arrays.equals(expected, actual), name + " differs");
        for (byte[] other : seen) Check.that(!Arrays.equals(other, actual), name + " shows nothing new");
        seen.add(actual);
    }

    private void checkEnd(String linkLog) throws IOException {
        String[] actual = journal.toString().split("\n");
        List<String> expected = Files.readAllLines(reference.resolve("journal"));
        for (int i = 0; i < actual.length; ++i) Check.equal(expected.get(i), actual[i], "line " + i);
        Check.equal(expected.size(), actual.length, "lines of the journal");
        Check.that(drawnInAll >= 2000, "only " + drawnInAll + " frames");
        Check.equal(0, Bitmap.locks, "bitmaps left locked");
        for (Method method : JniTidemarkRender.class.getDeclaredMethods()) {
            String name = JniTidemarkRender.class.getName() + "." + method.getName() + " ";
            if (Modifier.isNative(method.getModifiers())) Check.that(linkLog.contains(name), name + "was never called");
        }
        System.out.println(drawnInAll + " frames, " + seen.size() + " pictures as in C++");
    }
}
