package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

import java.awt.image.BufferedImage;
import java.io.IOException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;

import javax.imageio.ImageIO;

/** Plays a scene to the host in Java: its pictures are those of the host in C++, byte for byte. */
public final class WholeRunTest {
    private final Path reference;
    private final Pictures pictures;
    private final JniTidemarkRender library = new JniTidemarkRender();
    private final List<byte[]> seen = new ArrayList<>();
    private WaterHost host;
    private int width;
    private int height;
    private boolean withInk;
    private int drawn;

    public static void main(String[] arguments) throws IOException {
        WholeRunTest test = new WholeRunTest(Path.of(arguments[1]));
        for (String line : Files.readAllLines(Path.of(arguments[0]))) {
            String[] words = line.trim().split("\\s+");
            if (!words[0].isEmpty() && !words[0].startsWith("#")) test.play(words);
        }
        test.checkEnd(Files.readString(Path.of(arguments[2])));
        GlContext.release();
    }

    private WholeRunTest(Path reference) throws IOException {
        this.reference = reference;
        pictures = new Pictures(read("portrait.png"), read("landscape.png"), read("water.png"));
    }

    private Bitmap read(String name) throws IOException {
        BufferedImage image = ImageIO.read(reference.resolve(name).toFile());
        int[] colors = image.getRGB(0, 0, image.getWidth(), image.getHeight(), null, 0, image.getWidth());
        return Bitmap.createBitmap(colors, image.getWidth(), image.getHeight(), Bitmap.Config.ARGB_8888);
    }

    private void play(String[] words) throws IOException {
        switch (words[0]) {
            case "view":
                width = Integer.parseInt(words[1]);
                height = Integer.parseInt(words[2]);
                GlContext.open(width, height);
                if (host == null) host = new WaterHost(library, new Look(), width, height, 1);
                host.resize(width, height);
                host.handOver(pictures);
                host.setUp(withInk);
                break;
            case "lose":
                GlContext.open(width, height);
                host.setUp(withInk);
                break;
            case "ink":
                withInk = words[1].equals("on");
                host.setUp(withInk);
                break;
            case "rain":
                host.rain(words[1].equals("on"));
                break;
            case "touch":
                touch(Integer.parseInt(words[1]), Integer.parseInt(words[2]), Integer.parseInt(words[3]),
                        Float.parseFloat(words[4]));
                break;
            case "stroke":
                stroke(Arrays.stream(words, 1, 6).mapToInt(Integer::parseInt).toArray(), Float.parseFloat(words[6]));
                break;
            case "clear":
                host.clearInk();
                Check.equal(0, library.getClearInkValue(), "ink value of cleared water");
                break;
            case "frames":
                drawFrames(Integer.parseInt(words[1]));
                break;
            case "picture":
                comparePicture(words[1]);
                break;
            default:
                throw new AssertionError("cannot play " + words[0]);
        }
    }

    private void touch(int action, int x, int y, float pressure) {
        host.touch(action, x, y, pressure);
        int value = action == WaterHost.CANCEL ? 0 : 1;
        if (withInk) Check.equal(value, library.getClearInkValue(), "ink value of a touch");
    }

    private void stroke(int[] path, float pressure) {
        int frames = path[4];
        touch(WaterHost.DOWN, path[0], path[1], pressure);
        for (int i = 1; i <= frames; ++i) {
            int x = path[0] + (path[2] - path[0]) * i / frames;
            int y = path[1] + (path[3] - path[1]) * i / frames;
            touch(WaterHost.MOVE, x, y, pressure);
            drawFrames(1);
        }
        touch(WaterHost.UP, path[2], path[3], pressure);
    }

    // The collector moves every array between the frames.
    private void drawFrames(int count) {
        for (int i = 0; i < count; ++i) {
            if (!host.advance(1.0 / 60)) continue;
            host.draw();
            ++drawn;
            System.gc();
        }
    }

    private void comparePicture(String name) throws IOException {
        byte[] expected = Files.readAllBytes(reference.resolve(name + ".rgba"));
        byte[] actual = GlContext.pixels(width, height);
        Check.equal(expected.length, actual.length, "bytes of " + name);
        int differing = 0;
        for (int i = 0; i < actual.length; ++i) {
            if (actual[i] != expected[i]) ++differing;
        }
        Check.equal(0, differing, "differing bytes of " + name);
        for (byte[] other : seen) Check.that(!Arrays.equals(other, actual), name + " shows nothing new");
        seen.add(actual);
    }

    private void checkEnd(String linkLog) throws IOException {
        Check.equal(Files.readString(reference.resolve("drawn")).trim(), Integer.toString(drawn), "frames drawn");
        Check.that(drawn >= 2000, "only " + drawn + " frames");
        Check.equal(0, Bitmap.locks, "bitmaps left locked");
        for (Method method : JniTidemarkRender.class.getDeclaredMethods()) {
            String name = JniTidemarkRender.class.getName() + "." + method.getName() + " ";
            if (Modifier.isNative(method.getModifiers())) Check.that(linkLog.contains(name), name + "was never called");
        }
        System.out.println(drawn + " frames, " + seen.size() + " pictures as in C++");
    }
}
